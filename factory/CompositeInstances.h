// SPDX-License-Identifier: Apache-2.0
// How composite instances are read and made, for every row of the model.
#pragma once

#include <cmpidt.h>

#include <vector>

#include "factory/Model.h"

namespace QV::IPConfigComposite {

// What the request says about the instances to make; see IPConfigObjectFactory for the meaning of each.
struct Request {
  const CMPIBroker* broker;
  const CMPIObjectPath* ref;
  const char** properties;
  bool noFilter;
  CMPIStatus* status;
};

// What the getAll and the make member of a class do; `function` is the member's own name, for the trace.
int readComposites(const CompositeClass& row, const char* function, const Request& request, const CMPIContext* ctx,
                   const char* className, std::vector<CMPIInstance*>& out);
CMPIInstance* makeComposite(const CompositeClass& row, const char* function, const Request& request);

}  // namespace QV::IPConfigComposite
