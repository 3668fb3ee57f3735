// SPDX-License-Identifier: Apache-2.0
// The addresses of an interface as values: parsed once where they come in (a client's text, a state file, the octets of
// the wire), printed once where they go out. A value may be one that no host can have, since processors show such
// values too; what a client asks for passes through requireHost and requireUsable, or the processor would take itself
// off the network.
#pragma once

#include <array>
#include <compare>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace QV {

// Four octets that are written in dotted decimal form.
class DottedDecimal {
 public:
  using Octets = std::array<std::uint8_t, 4>;  // in network order

  constexpr DottedDecimal() = default;
  constexpr explicit DottedDecimal(const Octets& octets) : octets_(octets) {}

  auto operator<=>(const DottedDecimal&) const = default;

  const Octets& octets() const { return octets_; }
  std::uint32_t number() const;  // the first octet in the highest bits
  std::string text() const;
  bool isZero() const { return octets_ == Octets{}; }

 protected:
  // Exactly four decimal octets without blanks, signs or leading zeros (which some readers take as octal).
  static std::optional<Octets> parseOctets(std::string_view text);

 private:
  Octets octets_{};
};

class Ipv4Address : public DottedDecimal {
 public:
  using DottedDecimal::DottedDecimal;

  // Nothing if the text is of another form.
  static std::optional<Ipv4Address> parse(std::string_view text);

  // An address that a host can have. Throws std::invalid_argument, naming the text and the reason, if the text is
  // not dotted decimal, or one of 0.0.0.0/8 (this network), 127.0.0.0/8 (loopback), 224.0.0.0/4 (multicast) or
  // 240.0.0.0/4 (reserved, broadcast); RFC 6890.
  static Ipv4Address requireHost(const std::string& text);

  // Why no host can have it; null if one can.
  const char* unusable() const;
};

class SubnetMask : public DottedDecimal {
 public:
  using DottedDecimal::DottedDecimal;

  // Nothing if the text is of another form.
  static std::optional<SubnetMask> parse(std::string_view text);

  // Throws std::invalid_argument, naming the text and the reason, if it is not dotted decimal, not contiguous, or
  // leaves no network (0.0.0.0) or no peer (255.255.255.255).
  static SubnetMask requireUsable(const std::string& text);

  // Why it is of no use; null if it is.
  const char* unusable() const;

  // Nothing if the mask is not contiguous.
  std::optional<int> prefixLength() const;
};

// Throws std::invalid_argument if the address is its subnet's own or its broadcast address. A mask of 31 bits has
// neither (RFC 3021).
void requireHostOfSubnet(const Ipv4Address& address, const SubnetMask& mask);

class Ipv6Address {
 public:
  using Octets = std::array<std::uint8_t, 16>;

  constexpr Ipv6Address() = default;
  constexpr explicit Ipv6Address(const Octets& octets) : octets_(octets) {}

  // Nothing if the text is not an IPv6 address.
  static std::optional<Ipv6Address> parse(const std::string& text);

  auto operator<=>(const Ipv6Address&) const = default;

  std::string text() const;  // RFC 5952
  bool isZero() const { return octets_ == Octets{}; }

 private:
  Octets octets_{};
};

class MacAddress {
 public:
  using Octets = std::array<std::uint8_t, 6>;

  constexpr MacAddress() = default;
  constexpr explicit MacAddress(const Octets& octets) : octets_(octets) {}

  // "aa:bb:cc:dd:ee:ff", in letters of either case; nothing if the text is of another form.
  static std::optional<MacAddress> parse(std::string_view text);

  auto operator<=>(const MacAddress&) const = default;

  std::string text() const;

 private:
  Octets octets_{};
};

}  // namespace QV
