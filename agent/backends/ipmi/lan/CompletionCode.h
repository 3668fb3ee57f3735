// Completion codes (IPMI 2.0, table 5-2; those from 0x80 are the LAN configuration commands' own, table 23-3).
#pragma once

#include <cstdint>
#include <string>

namespace QV::Ipmi::CompletionCode {

constexpr std::uint8_t done = 0x00;
constexpr std::uint8_t parameterNotSupported = 0x80;
constexpr std::uint8_t setInProgress = 0x81;
constexpr std::uint8_t readOnly = 0x82;
constexpr std::uint8_t parameterOutOfRange = 0xC9;
constexpr std::uint8_t notFound = 0xCB;
constexpr std::uint8_t invalidData = 0xCC;

// "invalid value (0xCC)"; a code without a meaning here as "completion code 0x..".
std::string describe(std::uint8_t code);

}  // namespace QV::Ipmi::CompletionCode
