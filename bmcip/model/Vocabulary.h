// SPDX-License-Identifier: Apache-2.0
// The names of the composite classes, and the words for the codes of their properties.
#pragma once

#include <string>
#include <string_view>

namespace Bmcip {

inline constexpr const char* classPrefix = "YRNx_MgmtHw";
inline constexpr const char* systemClass = "YRNx_MgmtHwComputerSystem";
inline constexpr const char* endpointClass = "YRNx_MgmtHwIPProtocolEndPoint";
inline constexpr const char* accessPointClass = "YRNx_MgmtHwRemoteServiceAccessPoint";

inline constexpr const char* staticOrigin = "static";
inline constexpr const char* gatewayContext = "gateway";
inline constexpr const char* dnsContext = "DNS server";

// The word for a property's code, "static" for "3" of AddressOrigin. A code without one is "code 99", and no value
// remains none.
std::string wordOf(std::string_view property, const std::string& code);

}  // namespace Bmcip
