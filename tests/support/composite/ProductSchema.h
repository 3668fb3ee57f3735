// SPDX-License-Identifier: Apache-2.0
// The product's classes for an object manager within a test.
#pragma once

#include <initializer_list>
#include <string_view>

#include "cimom/ObjectManager.h"

namespace Testing {

// Reads the composite classes, the underlying ones and what both are derived from, and shows all of them in each of the
// namespaces: providers are held against whatever classes an object manager may show them.
void loadProductSchema(Cimom::ObjectManager& manager, std::initializer_list<std::string_view> nameSpaces);

}  // namespace Testing
