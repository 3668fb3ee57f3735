// What an IPv4 address and mask must be before they may reach a management processor, which would otherwise take itself
// off the network.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace QV {

// An IPv4 address or mask as a number, the first octet in the highest bits.
using Ipv4 = std::uint32_t;

// The number of a dotted decimal text: exactly four decimal octets without blanks, signs or leading zeros (which some
// readers take as octal). Nothing where the text is of another form.
std::optional<Ipv4> parseIpv4(std::string_view text);

// The number of an address that a host can have. Throws std::invalid_argument, naming the text and the reason, where
// the text is no dotted decimal address, or one of 0.0.0.0/8 (this network), 127.0.0.0/8 (loopback), 224.0.0.0/4
// (multicast) or 240.0.0.0/4 (reserved, broadcast); RFC 6890.
Ipv4 requireHostAddress(const std::string& text);

// The number of a usable subnet mask. Throws std::invalid_argument, naming the text and the reason, where it is no
// dotted decimal text, not contiguous, or leaves no network (0.0.0.0) or no peer (255.255.255.255).
Ipv4 requireSubnetMask(const std::string& text);

// Throws std::invalid_argument where the address is its subnet's own or its broadcast address. A mask of 31 bits has
// neither (RFC 3021).
void requireHostOfSubnet(Ipv4 address, Ipv4 mask);

}  // namespace QV
