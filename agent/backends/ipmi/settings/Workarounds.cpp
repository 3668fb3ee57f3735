#include "agent/backends/ipmi/settings/Workarounds.h"

#include <freeipmi/freeipmi.h>

#include <map>

#include "agent/backends/ipmi/settings/SettingValues.h"

namespace QV::Ipmi {
namespace {

const std::map<std::string, unsigned> flags = {
    {"authcap", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_AUTHENTICATION_CAPABILITIES},
    {"intel20", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_INTEL_2_0_SESSION},
    {"supermicro20", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_SUPERMICRO_2_0_SESSION},
    {"sun20", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_SUN_2_0_SESSION},
    {"opensesspriv", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_OPEN_SESSION_PRIVILEGE},
    {"integritycheckvalue", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_NON_EMPTY_INTEGRITY_CHECK_VALUE},
    {"nochecksumcheck", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_NO_CHECKSUM_CHECK}};

}  // namespace

unsigned workaroundFlag(const std::string& name) {
  if (const auto flag = flags.find(name); flag != flags.end()) return flag->second;
  std::string known;
  for (const auto& [knownName, flag] : flags) known += (known.empty() ? "" : ", ") + knownName;
  refuseValue("workarounds", name, "must be one of " + known);
}

}  // namespace QV::Ipmi
