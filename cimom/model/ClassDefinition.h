// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "cimom/model/NamedList.h"
#include "cimom/model/Shared.h"
#include "cimom/model/Value.h"

namespace Cimom {

// A qualifier with its value and flavor (DSP0004).
struct Qualifier {
  std::string name;
  Value value;
  bool toSubclass = true;     // false: Restricted
  bool overridable = true;    // false: DisableOverride
  bool translatable = false;  // Translatable
  bool propagated = false;    // inherited as it is
};

using Qualifiers = std::vector<Qualifier>;

// A qualifier as the schema declares it: its default value, of its type, its flavor, and what it may stand at.
struct QualifierDeclaration {
  Qualifier qualifier;
  unsigned arraySize = 0;           // of a fixed-size array, else 0
  std::vector<std::string> scopes;  // "property", "any" …
};

// The qualifier of that name, or null.
const Qualifier* findQualifier(const Qualifiers& qualifiers, std::string_view name);

// Whether a boolean qualifier is there and true.
bool isQualified(const Qualifiers& qualifiers, std::string_view name);

// The type of the values of what is declared with that type and those qualifiers: a string that embeds an instance or
// object has instances as values.
CMPIType valueType(CMPIType type, const Qualifiers& qualifiers);

// A property of a class, or a parameter of a method.
struct PropertyDeclaration {
  std::string name;
  CMPIType type = CMPI_null;   // arrays with the bit CMPI_ARRAY; CMPI_ref for a reference
  std::string referenceClass;  // the class that a reference refers to, else empty
  unsigned arraySize = 0;      // of a fixed-size array, else 0
  Value defaultValue;          // null if the schema has none
  Qualifiers qualifiers;       // inherited ones included, but for the restricted ones
  std::string originClass;     // the class that declared it first
  bool propagated = false;     // inherited as it is; false if this class declares or overrides it

  bool isKey() const { return isQualified(qualifiers, "Key"); }
  bool isReference() const { return !referenceClass.empty(); }
  CMPIType valueType() const { return Cimom::valueType(type, qualifiers); }
};

struct MethodDeclaration {
  std::string name;
  CMPIType returnType = CMPI_null;
  std::vector<PropertyDeclaration> parameters;
  Qualifiers qualifiers;
  std::string originClass;
  bool propagated = false;
};

// A class with everything that it inherits: the superclass's features come first, in the superclass's order, an
// overriding one in the place of the one that it overrides.
struct ClassDefinition {
  std::string name;
  const ClassDefinition* superclass = nullptr;
  Qualifiers qualifiers;
  NamedList<PropertyDeclaration> properties;
  std::vector<std::size_t> keys;                               // the indexes of those properties that are keys
  Shared<NamedValues::Names> keyNames = NamedValues::Names();  // and their names, for the paths of the instances
  NamedList<MethodDeclaration> methods;
  std::string declaredAt;  // "FILE:LINE"

  const PropertyDeclaration* findProperty(std::string_view propertyName) const;
  const MethodDeclaration* findMethod(std::string_view methodName) const;
  bool isAssociation() const { return isQualified(qualifiers, "Association"); }
  // Whether this is the class of that name or one of its subclasses.
  bool isA(std::string_view className) const;
};

}  // namespace Cimom
