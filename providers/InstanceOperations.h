// The read operations of the six providers that serve a composite class, told once; a unit is a row.
#pragma once

#include <cmpift.h>

#include <string>

#include "IPConfigObjectFactory.h"

namespace QV::IPConfigComposite {

struct InstanceUnit {
  const std::string& component;  // the unit's logger
  const char* file;              // the unit's name, as its trace lines show it
  GetAll getAll;                 // reads every instance of the unit's class
};

// One call of an operation: the unit, its broker, and the operation's own name for the trace.
struct InstanceCall {
  const InstanceUnit& unit;
  const CMPIBroker* broker;
  const char* function;
};

// Answers the first instance whose path equals the requested one; nothing, with the status as it stands, where none
// does. A path without keys is refused.
CMPIStatus getInstance(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char** properties);

// Answers every instance, null ones included.
CMPIStatus enumInstances(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                         const CMPIObjectPath* op, const char** properties);

// Answers the path of every instance that has one.
CMPIStatus enumInstanceNames(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                             const CMPIObjectPath* op);

}  // namespace QV::IPConfigComposite
