// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Call.h"
#include "cimom/cimxml/ClassWriter.h"

namespace Cimom::CimXml {
namespace {

const ClassDefinition& requireClass(const Call& call, const std::string& name, CMPIrc whenUnknown) {
  const ClassDefinition* definition = call.manager.classes.find(call.request.nameSpace, name);
  if (!definition) {
    throw OperationError(whenUnknown, "unknown class \"" + name + "\"");
  }
  return *definition;
}

ClassView viewOf(const Parameters& parameters) {
  return {parameters.flag("LocalOnly", true), parameters.flag("IncludeQualifiers", true),
          parameters.flag("IncludeClassOrigin", false), filterOf(parameters.propertyList())};
}

// The classes below the one that the client names, or below the root of all.
std::vector<const ClassDefinition*> requestedClasses(const Call& call) {
  const std::string name = call.parameters.className("ClassName");
  if (!name.empty()) {
    requireClass(call, name, CMPI_RC_ERR_INVALID_CLASS);
  }
  return call.manager.classes.subclasses(call.request.nameSpace, name, call.parameters.flag("DeepInheritance", false));
}

}  // namespace

void getClass(Call& call) {
  const auto& definition = requireClass(call, call.parameters.requiredClassName("ClassName"), CMPI_RC_ERR_NOT_FOUND);
  const auto scope = call.xml.element("IRETURNVALUE");
  ClassWriter(call.xml, viewOf(call.parameters)).write(definition);
}

void enumerateClasses(Call& call) {
  const auto classes = requestedClasses(call);
  ClassWriter writer(call.xml, viewOf(call.parameters));
  const auto scope = call.xml.element("IRETURNVALUE");
  for (const ClassDefinition* definition : classes) {
    writer.write(*definition);
  }
}

void enumerateClassNames(Call& call) {
  const auto classes = requestedClasses(call);
  const auto scope = call.xml.element("IRETURNVALUE");
  for (const ClassDefinition* definition : classes) {
    const auto name = call.xml.element("CLASSNAME", "NAME", definition->name);
  }
}

void getQualifier(Call& call) {
  const auto name = call.parameters.text("QualifierName");
  if (!name) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "parameter QualifierName is missing");
  }
  const QualifierDeclaration* declaration = call.manager.classes.findQualifierDeclaration(*name);
  if (!declaration) {
    throw OperationError(CMPI_RC_ERR_NOT_FOUND, "unknown qualifier \"" + *name + "\"");
  }
  const auto scope = call.xml.element("IRETURNVALUE");
  ClassWriter(call.xml, {}).write(*declaration);
}

void enumerateQualifiers(Call& call) {
  ClassWriter writer(call.xml, {});
  const auto scope = call.xml.element("IRETURNVALUE");
  for (const QualifierDeclaration* declaration : call.manager.classes.qualifierDeclarations()) {
    writer.write(*declaration);
  }
}

}  // namespace Cimom::CimXml
