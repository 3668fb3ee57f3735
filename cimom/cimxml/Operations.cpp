// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Operations.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include "cimom/broker/RequestScope.h"
#include "cimom/cimxml/Call.h"
#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

struct Operation {
  std::string_view name;
  void (*perform)(Call&);
  std::vector<std::string_view> parameters;
};

const std::vector<Operation>& operations() {
  static const std::vector<Operation> table = {
      {"EnumerateInstances",
       enumerateInstances,
       {"ClassName", "LocalOnly", "DeepInheritance", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
      {"EnumerateInstanceNames", enumerateInstanceNames, {"ClassName"}},
      {"GetInstance",
       getInstance,
       {"InstanceName", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
      {"CreateInstance", createInstance, {"NewInstance"}},
      {"ModifyInstance", modifyInstance, {"ModifiedInstance", "IncludeQualifiers", "PropertyList"}},
      {"DeleteInstance", deleteInstance, {"InstanceName"}},
      {"GetProperty", getProperty, {"InstanceName", "PropertyName"}},
      {"SetProperty", setProperty, {"InstanceName", "PropertyName", "NewValue"}},
      {"Associators",
       associators,
       {"ObjectName", "AssocClass", "ResultClass", "Role", "ResultRole", "IncludeQualifiers", "IncludeClassOrigin",
        "PropertyList"}},
      {"AssociatorNames", associatorNames, {"ObjectName", "AssocClass", "ResultClass", "Role", "ResultRole"}},
      {"References",
       references,
       {"ObjectName", "ResultClass", "Role", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
      {"ReferenceNames", referenceNames, {"ObjectName", "ResultClass", "Role"}},
      {"OpenEnumerateInstances",
       openEnumerateInstances,
       {"ClassName", "DeepInheritance", "IncludeClassOrigin", "PropertyList", "FilterQueryLanguage", "FilterQuery",
        "OperationTimeout", "ContinueOnError", "MaxObjectCount"}},
      {"OpenEnumerateInstancePaths",
       openEnumerateInstancePaths,
       {"ClassName", "FilterQueryLanguage", "FilterQuery", "OperationTimeout", "ContinueOnError", "MaxObjectCount"}},
      {"OpenAssociatorInstances",
       openAssociatorInstances,
       {"InstanceName", "AssocClass", "ResultClass", "Role", "ResultRole", "IncludeClassOrigin", "PropertyList",
        "FilterQueryLanguage", "FilterQuery", "OperationTimeout", "ContinueOnError", "MaxObjectCount"}},
      {"OpenAssociatorInstancePaths",
       openAssociatorInstancePaths,
       {"InstanceName", "AssocClass", "ResultClass", "Role", "ResultRole", "FilterQueryLanguage", "FilterQuery",
        "OperationTimeout", "ContinueOnError", "MaxObjectCount"}},
      {"OpenReferenceInstances",
       openReferenceInstances,
       {"InstanceName", "ResultClass", "Role", "IncludeClassOrigin", "PropertyList", "FilterQueryLanguage",
        "FilterQuery", "OperationTimeout", "ContinueOnError", "MaxObjectCount"}},
      {"OpenReferenceInstancePaths",
       openReferenceInstancePaths,
       {"InstanceName", "ResultClass", "Role", "FilterQueryLanguage", "FilterQuery", "OperationTimeout",
        "ContinueOnError", "MaxObjectCount"}},
      {"PullInstancesWithPath", pullInstancesWithPath, {"EnumerationContext", "MaxObjectCount"}},
      {"PullInstancePaths", pullInstancePaths, {"EnumerationContext", "MaxObjectCount"}},
      {"CloseEnumeration", closeEnumeration, {"EnumerationContext"}},
      {"EnumerationCount", enumerationCount, {"EnumerationContext"}},
      {"GetClass", getClass, {"ClassName", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
      {"EnumerateClasses",
       enumerateClasses,
       {"ClassName", "DeepInheritance", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin"}},
      {"EnumerateClassNames", enumerateClassNames, {"ClassName", "DeepInheritance"}},
      {"GetQualifier", getQualifier, {"QualifierName"}},
      {"EnumerateQualifiers", enumerateQualifiers, {}}};
  return table;
}

const Operation& findOperation(const std::string& name) {
  const auto operation = std::find_if(operations().begin(), operations().end(),
                                      [&name](const Operation& candidate) { return sameName(candidate.name, name); });
  if (operation == operations().end()) {
    throw OperationError(CMPI_RC_ERR_NOT_SUPPORTED, "operation " + name + " is not supported");
  }
  return *operation;
}

void describeCaller(const CMPIContext* context, const OperationContext& manager, const Parameters& parameters) {
  CMPIValue flags{};
  flags.uint32 = (parameters.flag("LocalOnly", false) ? CMPI_FLAG_LocalOnly : 0) |
                 (parameters.flag("DeepInheritance", false) ? CMPI_FLAG_DeepInheritance : 0) |
                 (parameters.flag("IncludeQualifiers", false) ? CMPI_FLAG_IncludeQualifiers : 0) |
                 (parameters.flag("IncludeClassOrigin", false) ? CMPI_FLAG_IncludeClassOrigin : 0);
  requireOk(CMAddContextEntry(context, CMPIInvocationFlags, &flags, CMPI_uint32));
  addPrincipal(context, manager.user);
}

void requireNamespace(const OperationContext& manager, const Request& request) {
  if (!manager.classes.hasNamespace(request.nameSpace)) {
    throw OperationError(CMPI_RC_ERR_INVALID_NAMESPACE, "unknown namespace \"" + request.nameSpace + "\"");
  }
}

}  // namespace

void perform(const OperationContext& manager, const Request& request, XmlWriter& xml) {
  if (!request.isIntrinsic) {
    return callMethod(manager, request, xml);
  }
  const Operation& operation = findOperation(request.method);
  requireNamespace(manager, request);
  const Parameters parameters(request, operation.parameters);
  RequestScope scope(manager.broker, manager.deadline);
  const CMPIContext* context = scope.context();
  describeCaller(context, manager, parameters);
  const ObjectBuilder objects(manager.broker, manager.classes, request.nameSpace);
  std::string host = manager.host;
  Call call{manager, request, parameters, context, objects, xml, host};
  operation.perform(call);
}

}  // namespace Cimom::CimXml
