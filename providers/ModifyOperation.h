// ModifyInstance of the three providers that accept it, told once; what differs is the factory member that writes.
#pragma once

#include "InstanceOperations.h"

namespace QV::IPConfigComposite {

using Modify = int (IPConfigObjectFactory::*)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                                              const char**, bool, const CMPIInstance*, CMPIStatus*);

// Hands the client's instance to the factory member. A null instance is refused with CMPI_RC_ERR_FAILED.
CMPIStatus modifyInstance(const InstanceCall& call, Modify modify, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* cop, const CMPIInstance* ci, const char** properties);

}  // namespace QV::IPConfigComposite
