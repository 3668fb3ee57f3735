// The names of the composite classes, as the schema declares them.
#pragma once

namespace QV::IPConfigComposite::ClassNames {

inline constexpr const char* computerSystem = "YRNx_MgmtHwComputerSystem";
inline constexpr const char* ipProtocolEndpoint = "YRNx_MgmtHwIPProtocolEndPoint";
inline constexpr const char* assignmentSettingSequence = "YRNx_MgmtHwIPAssignmentSettingSequence";
inline constexpr const char* staticAssignmentSetting = "YRNx_MgmtHwStaticIPAssignmentSettingData";
inline constexpr const char* dhcpAssignmentSetting = "YRNx_MgmtHwDHCPAssignmentSettingData";
inline constexpr const char* remoteServiceAccessPoint = "YRNx_MgmtHwRemoteServiceAccessPoint";

inline constexpr const char* hostedAccessPoint = "YRNx_MgmtHwIPHostedAccessPoint";
inline constexpr const char* remoteHostedAccessPoint = "YRNx_MgmtHwIPRemoteHostedAccessPoint";
inline constexpr const char* clientAccess = "YRNx_MgmtHwClientAccess";
inline constexpr const char* elementSettingData = "YRNx_MgmtHwIPElementSettingData";
inline constexpr const char* staticOrderedMember = "YRNx_MgmtHwStaticIPOrderedMemberOfCollection";
inline constexpr const char* dhcpOrderedMember = "YRNx_MgmtHwDHCPOrderedMemberOfCollection";

}  // namespace QV::IPConfigComposite::ClassNames
