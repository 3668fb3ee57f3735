// SPDX-License-Identifier: Apache-2.0
// A computer system whose IP configuration the underlying classes show.
#pragma once

#include <string>

#include "agent/processor/ManagementProcessor.h"

namespace QV {

struct System {
  std::string creationClassName;  // the CIM class of the system, by which its parts refer to it
  std::string settingPrefix;      // the first field of its settings' InstanceIDs
  ManagementProcessor configuration;
};

}  // namespace QV
