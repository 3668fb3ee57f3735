// SPDX-License-Identifier: Apache-2.0
// Extrinsic methods (DSP0200, 5.3.2 and 5.4): arguments get their types from the class, as keys and properties do.
#include "cimom/broker/CmpiValue.h"
#include "cimom/broker/Handle.h"
#include "cimom/broker/RequestScope.h"
#include "cimom/cimxml/Call.h"
#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

const MethodDeclaration& requireMethod(const OperationContext& manager, const Request& request) {
  const std::string& className = request.target.className;
  if (!manager.classes.hasNamespace(request.nameSpace)) {
    throw OperationError(CMPI_RC_ERR_INVALID_NAMESPACE, "unknown namespace \"" + request.nameSpace + "\"");
  }
  const ClassDefinition* definition = manager.classes.find(request.nameSpace, className);
  if (!definition) {
    throw OperationError(CMPI_RC_ERR_INVALID_CLASS, "unknown class \"" + className + "\"");
  }
  const MethodDeclaration* method = definition->findMethod(request.method);
  if (!method) {
    throw OperationError(CMPI_RC_ERR_METHOD_NOT_FOUND, "class " + className + " has no method " + request.method);
  }
  return *method;
}

CMPIArgs* newArguments(const CMPIBroker* broker) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIArgs* arguments = CMNewArgs(broker, &status);
  requireOk(status, arguments);
  return arguments;
}

CMPIArgs* readArguments(const OperationContext& manager, const Request& request, const MethodDeclaration& method,
                        const ObjectBuilder& objects) {
  CMPIArgs* arguments = newArguments(manager.broker);
  for (const Parameter& given : request.parameters) {
    const PropertyDeclaration* declared = findNamed(method.parameters, given.name);
    if (!declared) {
      throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "method " + method.name + " has no parameter " + given.name);
    }
    if (CMGetArg(arguments, declared->name.c_str(), nullptr).type != CMPI_null) {
      throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "parameter " + given.name + " is a duplicate");
    }
    const auto value = objects.argument(*declared, given);
    requireOk(CMAddArg(arguments, declared->name.c_str(), value.pointer(), value.type));
  }
  return arguments;
}

void writeArguments(XmlWriter& xml, ObjectWriter& writer, const MethodDeclaration& method, const CMPIArgs* arguments) {
  for (const auto& [name, value] : modelOf<Args>(arguments).arguments) {
    const auto scope = xml.element("PARAMVALUE", "NAME", name);
    const PropertyDeclaration* declared = findNamed(method.parameters, name);
    writer.type("PARAMTYPE", value.type(), declared ? declared->qualifiers : Qualifiers());
    writer.value(value);
  }
}

}  // namespace

void callMethod(const OperationContext& manager, const Request& request, XmlWriter& xml) {
  const MethodDeclaration& method = requireMethod(manager, request);
  RequestScope scope(manager.broker, manager.deadline);
  const CMPIContext* context = scope.context();
  addPrincipal(context, manager.user);
  const ObjectBuilder objects(manager.broker, manager.classes, request.nameSpace);
  const CMPIArgs* in = readArguments(manager, request, method, objects);
  CMPIArgs* out = newArguments(manager.broker);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIData data =
      CBInvokeMethod(manager.broker, context, objects.path(request.target), method.name.c_str(), in, out, &status);
  requireOk(status);
  const Cimom::Value returned = fromCmpi(CMIsNullValue(data) ? nullptr : &data.value, data.type);
  ObjectWriter writer(xml, manager.host, request.nameSpace);
  if (!returned.isNull()) {
    const auto value = xml.element("RETURNVALUE");
    writer.type("PARAMTYPE", returned.type(), method.qualifiers);
    writer.value(returned);
  }
  writeArguments(xml, writer, method, out);
}

}  // namespace Cimom::CimXml
