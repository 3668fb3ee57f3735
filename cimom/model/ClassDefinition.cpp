// SPDX-License-Identifier: Apache-2.0
#include "cimom/model/ClassDefinition.h"

#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom {

const Qualifier* findQualifier(const Qualifiers& qualifiers, std::string_view name) {
  return findNamed(qualifiers, name);
}

bool isQualified(const Qualifiers& qualifiers, std::string_view name) {
  const Qualifier* qualifier = findQualifier(qualifiers, name);
  return qualifier && qualifier->value.isTrue();
}

CMPIType valueType(CMPIType type, const Qualifiers& qualifiers) {
  if (elementTypeOf(type) != CMPI_string) {
    return type;
  }
  const bool isEmbedded = findQualifier(qualifiers, "EmbeddedInstance") || isQualified(qualifiers, "EmbeddedObject");
  return isEmbedded ? static_cast<CMPIType>(CMPI_instance | (type & CMPI_ARRAY)) : type;
}

const PropertyDeclaration* ClassDefinition::findProperty(std::string_view propertyName) const {
  return properties.find(propertyName);
}

const MethodDeclaration* ClassDefinition::findMethod(std::string_view methodName) const {
  return methods.find(methodName);
}

bool ClassDefinition::isA(std::string_view className) const {
  for (const ClassDefinition* ancestor = this; ancestor; ancestor = ancestor->superclass) {
    if (sameName(ancestor->name, className)) {
      return true;
    }
  }
  return false;
}

}  // namespace Cimom
