// SPDX-License-Identifier: Apache-2.0
// What a class declares, as text that two declarations can be compared by.
#pragma once

#include <functional>
#include <string>

#include "cimom/schema/Mof.h"

namespace Testing {

// A line for the class, and one for each of its own properties and methods in their order: types, defaults and
// qualifiers with their values and flavors, the qualifiers by name. Those that `isLeftOut` names are passed over.
std::string textOf(
    const Cimom::ClassDeclaration& declaration,
    const std::function<bool(const std::string&)>& isLeftOut = [](const std::string&) { return false; });

// The declaration of that name; null if there is none.
const Cimom::ClassDeclaration* findClass(const Cimom::MofDeclarations& declarations, const std::string& name);

}  // namespace Testing
