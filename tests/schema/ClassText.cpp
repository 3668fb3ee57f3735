// SPDX-License-Identifier: Apache-2.0
#include "tests/schema/ClassText.h"

#include <algorithm>
#include <map>

namespace Testing {

namespace {

using Cimom::Qualifiers;

std::string qualifiersText(const Qualifiers& qualifiers, const std::function<bool(const std::string&)>& isLeftOut) {
  std::map<std::string, std::string> sorted;
  for (const Cimom::Qualifier& qualifier : qualifiers) {
    if (isLeftOut(qualifier.name)) {
      continue;
    }
    std::string& text = sorted[qualifier.name];
    text = qualifier.value.toString();
    text += qualifier.toSubclass ? "" : " Restricted";
    text += qualifier.overridable ? "" : " DisableOverride";
    text += qualifier.translatable ? " Translatable" : "";
  }
  std::string text;
  for (const auto& [name, value] : sorted) {
    text += "\n      " + name + ' ' + value;
  }
  return text;
}

}  // namespace

std::string textOf(const Cimom::ClassDeclaration& declaration,
                   const std::function<bool(const std::string&)>& isLeftOut) {
  const Cimom::ClassDefinition& own = declaration.own;
  std::string text = own.name + " : " + declaration.superclassName + qualifiersText(own.qualifiers, isLeftOut);
  for (const Cimom::PropertyDeclaration& property : own.properties) {
    text += "\n  " + property.name + ' ' + std::to_string(property.type) + ' ' + property.referenceClass;
    text += '[' + std::to_string(property.arraySize) + "] = " + property.defaultValue.toString();
    text += qualifiersText(property.qualifiers, isLeftOut);
  }
  for (const Cimom::MethodDeclaration& method : own.methods) {
    text += "\n  " + method.name + "()";
  }
  return text + '\n';
}

const Cimom::ClassDeclaration* findClass(const Cimom::MofDeclarations& declarations, const std::string& name) {
  const auto found =
      std::ranges::find_if(declarations.classes, [&](const auto& candidate) { return candidate.own.name == name; });
  return found == declarations.classes.end() ? nullptr : &*found;
}

}  // namespace Testing
