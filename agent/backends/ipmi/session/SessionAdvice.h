// What libfreeipmi's error numbers mean to an administrator.
#pragma once

#include <string>

#include "agent/backends/ipmi/settings/IpmiSettings.h"

namespace QV::Ipmi {

// Why a session did not open and which setting or step helps. `error` is what ipmi_ctx_errnum gave.
std::string openingAdvice(const IpmiSettings& settings, int error);

}  // namespace QV::Ipmi
