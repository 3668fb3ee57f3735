// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "tests/cimom/cimxml/Messages.h"
#include "tests/support/Classes.h"

namespace Testing {

// INSTANCENAME of the endpoint of an interface.
inline std::string endpointName(const std::string& interface) {
  return instanceName(Classes::endpoint,
                      keyBinding("SystemCreationClassName", Classes::computerSystem) + keyBinding("SystemName", "BMC") +
                          keyBinding("CreationClassName", Classes::endpoint) + keyBinding("Name", interface));
}

}  // namespace Testing
