// SPDX-License-Identifier: Apache-2.0
// Addresses as tests write them, and as a failed expectation shows them.
#pragma once

#include <ostream>

#include "agent/processor/Addresses.h"

namespace QV {

inline Ipv4Address ipv4(const std::string& text) { return Ipv4Address::parse(text).value(); }
inline SubnetMask mask(const std::string& text) { return SubnetMask::parse(text).value(); }
inline Ipv6Address ipv6(const std::string& text) { return Ipv6Address::parse(text).value(); }
inline MacAddress mac(const std::string& text) { return MacAddress::parse(text).value(); }

inline std::ostream& operator<<(std::ostream& stream, const DottedDecimal& address) { return stream << address.text(); }
inline std::ostream& operator<<(std::ostream& stream, const Ipv6Address& address) { return stream << address.text(); }
inline std::ostream& operator<<(std::ostream& stream, const MacAddress& address) { return stream << address.text(); }

}  // namespace QV
