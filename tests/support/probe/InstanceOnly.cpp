// SPDX-License-Identifier: Apache-2.0
// A library that loads, with one factory of the two that a provider may have.
#include <cmpift.h>

extern "C" __attribute__((visibility("default"))) CMPIInstanceMI* InstanceOnly_Create_InstanceMI(const CMPIBroker*,
                                                                                                 const CMPIContext*,
                                                                                                 CMPIStatus*) {
  return nullptr;
}
