// What libfreeipmi can do about BMCs that do not keep to the standard, by the names that FreeIPMI's own tools use.
#pragma once

#include <string>

namespace QV::Ipmi {

// libfreeipmi's flag of that name for RMCP+ sessions. Throws std::runtime_error that names the known ones.
unsigned workaroundFlag(const std::string& name);

}  // namespace QV::Ipmi
