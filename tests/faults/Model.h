// SPDX-License-Identifier: Apache-2.0
// What the library must do with a request, stated a second time and independently: plain steps over the same function
// tables and the same agent, in the order in which they must happen, with what follows from every failure. Nothing of
// factory/ and providers/ is used or looked at; where the two differ, one of them is wrong.
#pragma once

#include <cmpift.h>

#include "tests/faults/Requests.h"

namespace Testing {

struct ModelCall {
  const CMPIBroker* broker;
  const CMPIContext* context;
  const CMPIResult* result;
  CMPIObjectPath* path;
  const CMPIInstance* instance;  // of ModifyInstance
  const char** properties;
};

CMPIStatus answerOfModel(const Request& request, const ModelCall& call);

}  // namespace Testing
