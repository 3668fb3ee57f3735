#include "cimom/model/ClassDefinition.h"

#include <algorithm>

#include "cimom/model/Names.h"

namespace Cimom {
namespace {

template <class Named>
const Named* findNamed(const std::vector<Named>& all, std::string_view name) {
  const auto found = std::ranges::find_if(all, [&](const Named& one) { return sameName(one.name, name); });
  return found == all.end() ? nullptr : &*found;
}

}  // namespace

const Qualifier* findQualifier(const Qualifiers& qualifiers, std::string_view name) {
  return findNamed(qualifiers, name);
}

bool isQualified(const Qualifiers& qualifiers, std::string_view name) {
  const Qualifier* qualifier = findQualifier(qualifiers, name);
  return qualifier && qualifier->value.type() == CMPI_boolean && !qualifier->value.isNull() &&
         qualifier->value.toCmpi().value.boolean;
}

const PropertyDeclaration* ClassDefinition::findProperty(std::string_view propertyName) const {
  return findNamed(properties, propertyName);
}

const MethodDeclaration* ClassDefinition::findMethod(std::string_view methodName) const {
  return findNamed(methods, methodName);
}

bool ClassDefinition::isA(std::string_view className) const {
  for (const ClassDefinition* ancestor = this; ancestor; ancestor = ancestor->superclass) {
    if (sameName(ancestor->name, className)) return true;
  }
  return false;
}

}  // namespace Cimom
