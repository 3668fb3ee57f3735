// SPDX-License-Identifier: Apache-2.0
// The operations, by what they do.
#pragma once

#include "tests/faults/model/Model.h"

namespace Testing::Model {

CMPIStatus readInstances(const Request& request);  // of a composite class
CMPIStatus changeInstance(const Request& request);
CMPIStatus readAssociations(const Request& request);  // the instances of an association class
CMPIStatus navigate(const Request& request);          // from a source to the far end

}  // namespace Testing::Model
