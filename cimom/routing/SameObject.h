// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string_view>

#include "cimom/model/ObjectPath.h"
#include "cimom/model/Value.h"

namespace Cimom {

// Whether two values are the same key: numbers of different types may be, and a text that shows the other's value.
// References are compared as sameObject does.
bool sameKey(const Value& one, const Value& other, std::string_view nameSpace);

// Whether two paths name the same object: by namespace, class and keys. A path without a namespace is one in
// `nameSpace`; hosts do not count, for a system may have several names.
bool sameObject(const ObjectPath& one, const ObjectPath& other, std::string_view nameSpace);

}  // namespace Cimom
