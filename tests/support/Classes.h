// SPDX-License-Identifier: Apache-2.0
// The classes that the library serves, by the names that clients know.
#pragma once

namespace Testing::Classes {

inline constexpr const char* computerSystem = "YRNx_MgmtHwComputerSystem";
inline constexpr const char* endpoint = "YRNx_MgmtHwIPProtocolEndPoint";
inline constexpr const char* remoteAccessPoint = "YRNx_MgmtHwRemoteServiceAccessPoint";
inline constexpr const char* sequence = "YRNx_MgmtHwIPAssignmentSettingSequence";
inline constexpr const char* staticSetting = "YRNx_MgmtHwStaticIPAssignmentSettingData";
inline constexpr const char* dhcpSetting = "YRNx_MgmtHwDHCPAssignmentSettingData";

inline constexpr const char* hostedAccessPoint = "YRNx_MgmtHwIPHostedAccessPoint";
inline constexpr const char* remoteHostedAccessPoint = "YRNx_MgmtHwIPRemoteHostedAccessPoint";
inline constexpr const char* clientAccess = "YRNx_MgmtHwClientAccess";
inline constexpr const char* elementSettingData = "YRNx_MgmtHwIPElementSettingData";
inline constexpr const char* staticOrderedMember = "YRNx_MgmtHwStaticIPOrderedMemberOfCollection";
inline constexpr const char* dhcpOrderedMember = "YRNx_MgmtHwDHCPOrderedMemberOfCollection";

}  // namespace Testing::Classes
