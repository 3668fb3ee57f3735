// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/ClassWriter.h"

#include <algorithm>

#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom::CimXml {
namespace {

const char* truth(bool value) { return value ? "true" : "false"; }

const char* propertyElement(const PropertyDeclaration& property) {
  if (property.isReference()) {
    return "PROPERTY.REFERENCE";
  }
  return isArray(property.type) ? "PROPERTY.ARRAY" : "PROPERTY";
}

const char* parameterElement(const PropertyDeclaration& parameter) {
  if (parameter.isReference()) {
    return isArray(parameter.type) ? "PARAMETER.REFARRAY" : "PARAMETER.REFERENCE";
  }
  return isArray(parameter.type) ? "PARAMETER.ARRAY" : "PARAMETER";
}

// TYPE, or the class that a reference refers to; and the size of a fixed array.
void writeType(XmlWriter& xml, const PropertyDeclaration& declaration) {
  if (declaration.isReference()) {
    xml.attribute("REFERENCECLASS", declaration.referenceClass);
  } else {
    xml.attribute("TYPE", xmlTypeName(declaration.type));
  }
  if (declaration.arraySize > 0) {
    xml.attribute("ARRAYSIZE", std::to_string(declaration.arraySize));
  }
}

// SCOPE: what a qualifier may stand at.
void writeScope(XmlWriter& xml, const std::vector<std::string>& scopes) {
  const auto element = xml.element("SCOPE");
  for (const char* name : {"CLASS", "ASSOCIATION", "REFERENCE", "PROPERTY", "METHOD", "PARAMETER", "INDICATION"}) {
    const auto covers = [name](const std::string& scope) { return sameName(scope, name) || sameName(scope, "any"); };
    xml.attribute(name, truth(std::ranges::any_of(scopes, covers)));
  }
}

}  // namespace

void ClassWriter::write(const ClassDefinition& definition) {
  const auto scope = xml_.element("CLASS", "NAME", definition.name);
  if (definition.superclass) {
    xml_.attribute("SUPERCLASS", definition.superclass->name);
  }
  qualifiers(definition.qualifiers);
  for (const auto& declaration : definition.properties) {
    if (isShown(declaration.propagated) && view_.properties.includes(declaration.name.c_str())) {
      property(declaration);
    }
  }
  for (const auto& declaration : definition.methods) {
    if (isShown(declaration.propagated)) {
      method(declaration);
    }
  }
}

void ClassWriter::write(const QualifierDeclaration& declaration) {
  const Qualifier& qualifier = declaration.qualifier;
  const auto scope = xml_.element("QUALIFIER.DECLARATION", "NAME", qualifier.name);
  xml_.attribute("TYPE", xmlTypeName(qualifier.value.type()));
  xml_.attribute("ISARRAY", truth(isArray(qualifier.value.type())));
  if (declaration.arraySize > 0) {
    xml_.attribute("ARRAYSIZE", std::to_string(declaration.arraySize));
  }
  flavor(qualifier);
  writeScope(xml_, declaration.scopes);
  values_.value(qualifier.value);
}

bool ClassWriter::isShown(bool propagated) const { return !view_.localOnly || !propagated; }

void ClassWriter::qualifiers(const Qualifiers& qualifiers) {
  if (!view_.includeQualifiers) {
    return;
  }
  for (const Qualifier& qualifier : qualifiers) {
    const char* type = xmlTypeName(qualifier.value.type());
    const auto scope = xml_.element("QUALIFIER", "NAME", qualifier.name);
    xml_.attribute("TYPE", type ? type : "string");
    if (qualifier.propagated) {
      xml_.attribute("PROPAGATED", truth(true));
    }
    flavor(qualifier);
    values_.value(qualifier.value);
  }
}

void ClassWriter::flavor(const Qualifier& qualifier) {
  xml_.attribute("OVERRIDABLE", truth(qualifier.overridable));
  xml_.attribute("TOSUBCLASS", truth(qualifier.toSubclass));
  xml_.attribute("TRANSLATABLE", truth(qualifier.translatable));
}

void ClassWriter::property(const PropertyDeclaration& property) {
  const auto scope = xml_.element(propertyElement(property), "NAME", property.name);
  writeType(xml_, property);
  origin(property.originClass, property.propagated);
  qualifiers(property.qualifiers);
  values_.value(property.defaultValue);
}

void ClassWriter::method(const MethodDeclaration& method) {
  const auto scope = xml_.element("METHOD", "NAME", method.name);
  if (const char* type = xmlTypeName(method.returnType)) {
    xml_.attribute("TYPE", type);
  }
  origin(method.originClass, method.propagated);
  qualifiers(method.qualifiers);
  for (const auto& declaration : method.parameters) {
    parameter(declaration);
  }
}

void ClassWriter::parameter(const PropertyDeclaration& parameter) {
  const auto scope = xml_.element(parameterElement(parameter), "NAME", parameter.name);
  writeType(xml_, parameter);
  qualifiers(parameter.qualifiers);
}

void ClassWriter::origin(const std::string& originClass, bool propagated) {
  if (view_.includeClassOrigin) {
    xml_.attribute("CLASSORIGIN", originClass);
  }
  xml_.attribute("PROPAGATED", truth(propagated));
}

}  // namespace Cimom::CimXml
