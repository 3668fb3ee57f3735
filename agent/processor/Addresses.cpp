// SPDX-License-Identifier: Apache-2.0
#include "agent/processor/Addresses.h"

#include <arpa/inet.h>

#include <bit>
#include <charconv>
#include <stdexcept>

namespace QV {
namespace {

// Enough of a refused text to recognise it by.
std::string quoted(const std::string& text) {
  constexpr std::size_t limit = 64;
  return '\'' + text.substr(0, limit) + (text.size() > limit ? "...'" : "'");
}

struct Range {
  std::uint32_t network;
  std::uint32_t mask;
  const char* reason;
};

constexpr Range unusableRanges[] = {
    {0xffffffff, 0xffffffff, "is the broadcast address"},
    {0x00000000, 0xff000000, "lies in 0.0.0.0/8, which names no host"},
    {0x7f000000, 0xff000000, "is a loopback address"},
    {0xe0000000, 0xf0000000, "is a multicast address"},
    {0xf0000000, 0xf0000000, "lies in the reserved range 240.0.0.0/4"},
};

// Parses what a client asks for, and refuses what its kind calls unusable.
template <typename Value>
Value require(const std::string& text, const char* what) {
  const std::string name = "the " + std::string(what) + ' ' + quoted(text) + ' ';
  const auto value = Value::parse(text);
  if (!value) {
    throw std::invalid_argument(name + "is not four decimal numbers from 0 to 255 with dots between them");
  }
  if (const char* reason = value->unusable()) {
    throw std::invalid_argument(name + reason);
  }
  return *value;
}

// The octet; the text is advanced past it.
std::optional<std::uint8_t> takeOctet(std::string_view& text) {
  std::uint8_t octet = 0;
  const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), octet);
  const auto length = static_cast<std::size_t>(stop - text.data());
  const bool leadingZero = length > 1 && text.front() == '0';
  if (error != std::errc{} || leadingZero) {
    return std::nullopt;
  }
  text.remove_prefix(length);
  return octet;
}

template <typename Value, typename Octets>
std::optional<Value> made(const std::optional<Octets>& octets) {
  if (!octets) {
    return std::nullopt;
  }
  return Value(*octets);
}

}  // namespace

std::optional<DottedDecimal::Octets> DottedDecimal::parseOctets(std::string_view text) {
  Octets octets{};
  for (std::size_t position = 0; position < octets.size(); ++position) {
    if (position > 0) {
      if (!text.starts_with('.')) {
        return std::nullopt;
      }
      text.remove_prefix(1);
    }
    const auto octet = takeOctet(text);
    if (!octet) {
      return std::nullopt;
    }
    octets[position] = *octet;
  }
  if (!text.empty()) {
    return std::nullopt;
  }
  return octets;
}

std::uint32_t DottedDecimal::number() const {
  std::uint32_t number = 0;
  for (const std::uint8_t octet : octets_) {
    number = number << 8 | octet;
  }
  return number;
}

std::string DottedDecimal::text() const {
  std::string text;
  for (const std::uint8_t octet : octets_) {
    text += (text.empty() ? "" : ".") + std::to_string(octet);
  }
  return text;
}

std::optional<Ipv4Address> Ipv4Address::parse(std::string_view text) { return made<Ipv4Address>(parseOctets(text)); }

Ipv4Address Ipv4Address::requireHost(const std::string& text) { return require<Ipv4Address>(text, "IPv4 address"); }

const char* Ipv4Address::unusable() const {
  for (const Range& range : unusableRanges) {
    if ((number() & range.mask) == range.network) {
      return range.reason;
    }
  }
  return nullptr;
}

std::optional<SubnetMask> SubnetMask::parse(std::string_view text) { return made<SubnetMask>(parseOctets(text)); }

SubnetMask SubnetMask::requireUsable(const std::string& text) { return require<SubnetMask>(text, "subnet mask"); }

const char* SubnetMask::unusable() const {
  const auto length = prefixLength();
  if (!length) {
    return "is not contiguous";
  }
  if (*length == 0) {
    return "leaves no network";
  }
  return *length == 32 ? "leaves no other host" : nullptr;
}

std::optional<int> SubnetMask::prefixLength() const {
  const std::uint32_t hostPart = ~number();
  if ((hostPart & (hostPart + 1)) != 0) {
    return std::nullopt;
  }
  return std::popcount(number());
}

void requireHostOfSubnet(const Ipv4Address& address, const SubnetMask& mask) {
  const std::uint32_t hostPart = ~mask.number();
  if (hostPart <= 1) {
    return;
  }
  const char* role = nullptr;
  if ((address.number() & hostPart) == 0) {
    role = "the network itself";
  }
  if ((address.number() & hostPart) == hostPart) {
    role = "its broadcast address";
  }
  if (role) {
    throw std::invalid_argument("the IPv4 address '" + address.text() + "' is, under the subnet mask '" + mask.text() +
                                "', " + role);
  }
}

std::optional<Ipv6Address> Ipv6Address::parse(const std::string& text) {
  Octets octets{};
  if (::inet_pton(AF_INET6, text.c_str(), octets.data()) != 1) {
    return std::nullopt;
  }
  return Ipv6Address(octets);
}

std::string Ipv6Address::text() const {
  std::array<char, INET6_ADDRSTRLEN> text{};
  ::inet_ntop(AF_INET6, octets_.data(), text.data(), text.size());
  return text.data();
}

std::optional<MacAddress> MacAddress::parse(std::string_view text) {
  Octets octets{};
  if (text.size() != octets.size() * 3 - 1) {
    return std::nullopt;
  }
  for (std::size_t position = 0; position < octets.size(); ++position) {
    const char* pair = text.data() + position * 3;
    const auto [rest, error] = std::from_chars(pair, pair + 2, octets[position], 16);
    const bool separated = position + 1 == octets.size() || pair[2] == ':';
    if (error != std::errc{} || rest != pair + 2 || !separated) {
      return std::nullopt;
    }
  }
  return MacAddress(octets);
}

std::string MacAddress::text() const {
  constexpr std::string_view hexadecimal = "0123456789abcdef";
  std::string text;
  for (const std::uint8_t octet : octets_) {
    if (!text.empty()) {
      text += ':';
    }
    text += hexadecimal[octet >> 4];
    text += hexadecimal[octet & 0xf];
  }
  return text;
}

}  // namespace QV
