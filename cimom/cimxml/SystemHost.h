// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

#include "cimom/model/Value.h"

namespace Cimom::CimXml {

// The host that the paths of an answer's objects in the namespace name: their own paths, their keys and their
// references. A path without a host is then of that system too, so that one system has one name in the whole answer.
// `otherwise` if they name none, or more than one.
std::string systemHost(const std::vector<Cimom::Value>& objects, const std::string& nameSpace,
                       const std::string& otherwise);

}  // namespace Cimom::CimXml
