#include "agent/processor/AddressValidation.h"

#include <charconv>
#include <stdexcept>

namespace QV {
namespace {

// Enough of a refused text to recognise it by.
std::string quoted(const std::string& text) {
  constexpr std::size_t limit = 64;
  return '\'' + text.substr(0, limit) + (text.size() > limit ? "...'" : "'");
}

std::string dotted(Ipv4 number) {
  return std::to_string(number >> 24) + '.' + std::to_string(number >> 16 & 0xff) + '.' +
         std::to_string(number >> 8 & 0xff) + '.' + std::to_string(number & 0xff);
}

struct Range {
  Ipv4 network;
  Ipv4 mask;
  const char* reason;
};

constexpr Range unusable[] = {
    {0xffffffff, 0xffffffff, "is the broadcast address"},
    {0x00000000, 0xff000000, "lies in 0.0.0.0/8, which names no host"},
    {0x7f000000, 0xff000000, "is a loopback address"},
    {0xe0000000, 0xf0000000, "is a multicast address"},
    {0xf0000000, 0xf0000000, "lies in the reserved range 240.0.0.0/4"},
};

Ipv4 requireIpv4(const std::string& text, const char* what) {
  if (const auto number = parseIpv4(text)) return *number;
  throw std::invalid_argument("the " + std::string(what) + ' ' + quoted(text) +
                              " is not four decimal numbers from 0 to 255 with dots between them");
}

// The octet's number; the text is advanced past it.
std::optional<Ipv4> takeOctet(std::string_view& text) {
  unsigned octet = 0;
  const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), octet);
  const auto length = static_cast<std::size_t>(stop - text.data());
  const bool leadingZero = length > 1 && text.front() == '0';
  if (error != std::errc{} || octet > 255 || leadingZero) return std::nullopt;
  text.remove_prefix(length);
  return octet;
}

}  // namespace

std::optional<Ipv4> parseIpv4(std::string_view text) {
  Ipv4 number = 0;
  for (int position = 0; position < 4; ++position) {
    if (position > 0) {
      if (!text.starts_with('.')) return std::nullopt;
      text.remove_prefix(1);
    }
    const auto octet = takeOctet(text);
    if (!octet) return std::nullopt;
    number = number << 8 | *octet;
  }
  if (!text.empty()) return std::nullopt;
  return number;
}

Ipv4 requireHostAddress(const std::string& text) {
  const Ipv4 address = requireIpv4(text, "IPv4 address");
  for (const Range& range : unusable) {
    if ((address & range.mask) == range.network)
      throw std::invalid_argument("the IPv4 address " + quoted(text) + ' ' + range.reason);
  }
  return address;
}

Ipv4 requireSubnetMask(const std::string& text) {
  const Ipv4 mask = requireIpv4(text, "subnet mask");
  const Ipv4 hostPart = ~mask;
  if ((hostPart & (hostPart + 1)) != 0)
    throw std::invalid_argument("the subnet mask " + quoted(text) + " is not contiguous");
  if (mask == 0) throw std::invalid_argument("the subnet mask " + quoted(text) + " leaves no network");
  if (hostPart == 0) throw std::invalid_argument("the subnet mask " + quoted(text) + " leaves no other host");
  return mask;
}

void requireHostOfSubnet(Ipv4 address, Ipv4 mask) {
  const Ipv4 hostPart = ~mask;
  if (hostPart <= 1) return;
  const char* role = nullptr;
  if ((address & hostPart) == 0) role = "the network itself";
  if ((address & hostPart) == hostPart) role = "its broadcast address";
  if (role)
    throw std::invalid_argument("the IPv4 address '" + dotted(address) + "' is, under the subnet mask '" +
                                dotted(mask) + "', " + role);
}

}  // namespace QV
