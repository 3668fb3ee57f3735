// SPDX-License-Identifier: Apache-2.0
// The least that a provider of composite endpoints can do: what the library costs is told beside it.
#pragma once

#include <cmpift.h>

CMPI_EXTERN_C CMPIInstanceMI* MinimalProvider_Create_InstanceMI(const CMPIBroker* broker, const CMPIContext* ctx,
                                                                CMPIStatus* status);
