// SPDX-License-Identifier: Apache-2.0
// The operations of the six providers that serve a composite class, stated once; a unit is a row.
#pragma once

#include <cmpift.h>

#include <string>

#include "factory/Model.h"

namespace QV::IPConfigComposite {

struct InstanceUnit {
  const std::string& component;  // the unit's logger
  const char* file;              // the unit's name, as its trace lines show it
  const CompositeClass& serves;
};

// One call of an operation: the unit, its broker, and the operation's own name for the trace.
struct InstanceCall {
  const InstanceUnit& unit;
  const CMPIBroker* broker;
  const char* function;
};

// Returns the first instance whose path equals the requested one; nothing, with the status as it stands, if none does
// (compatibility 15). A path without keys is refused.
CMPIStatus getInstance(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char** properties);

// Returns every instance, null ones included (compatibility 14).
CMPIStatus enumInstances(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                         const CMPIObjectPath* op, const char** properties);

// Returns the path of every instance that has one.
CMPIStatus enumInstanceNames(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                             const CMPIObjectPath* op);

// Hands the client's instance to the factory member that writes. A null instance is refused with CMPI_RC_ERR_FAILED.
CMPIStatus modifyInstance(const InstanceCall& call, Modify modify, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* cop, const CMPIInstance* ci, const char** properties);

}  // namespace QV::IPConfigComposite
