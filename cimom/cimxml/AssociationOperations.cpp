// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Call.h"

namespace Cimom::CimXml {
namespace {

// What every traversal takes. DSP0200 lets it start from a class too; that asks the schema, which this server does not.
struct Traversal {
  explicit Traversal(const Call& call)
      : assocClass(call.parameters.className("AssocClass")),
        resultClass(call.parameters.className("ResultClass")),
        role(call.parameters.text("Role").value_or("")),
        resultRole(call.parameters.text("ResultRole").value_or("")),
        list(call.parameters.propertyList()),
        names(list) {
    const ObjectName& name = call.parameters.instanceName("ObjectName");
    if (name.keys.empty()) {
      throw OperationError(CMPI_RC_ERR_NOT_SUPPORTED,
                           "association traversal from a class is not supported: name an instance");
    }
    source = call.objects.path(name);
  }

  const CMPIObjectPath* source = nullptr;
  std::string assocClass;
  std::string resultClass;
  std::string role;
  std::string resultRole;
  std::optional<std::vector<std::string>> list;
  PropertyNames names;
  CMPIStatus status{CMPI_RC_OK, nullptr};
};

void writeInstances(const Call& call, const Traversal& traversal, CMPIEnumeration* result) {
  ObjectWriter writer = call.writer(filterOf(traversal.list));
  writeResult(call, traversal.status, result, [&writer](const CMPIValue& value) { writer.objectWithPath(value.inst); });
}

void writeNames(const Call& call, const Traversal& traversal, CMPIEnumeration* result) {
  ObjectWriter writer = call.writer();
  writeResult(call, traversal.status, result, [&writer](const CMPIValue& value) { writer.objectPath(value.ref); });
}

}  // namespace

void associators(Call& call) {
  Traversal to(call);
  writeInstances(
      call, to,
      CBAssociators(call.manager.broker, call.context, to.source, orNull(to.assocClass), orNull(to.resultClass),
                    orNull(to.role), orNull(to.resultRole), to.names.get(), &to.status));
}

void associatorNames(Call& call) {
  Traversal to(call);
  writeNames(call, to,
             CBAssociatorNames(call.manager.broker, call.context, to.source, orNull(to.assocClass),
                               orNull(to.resultClass), orNull(to.role), orNull(to.resultRole), &to.status));
}

void references(Call& call) {
  Traversal to(call);
  writeInstances(call, to,
                 CBReferences(call.manager.broker, call.context, to.source, orNull(to.resultClass), orNull(to.role),
                              to.names.get(), &to.status));
}

void referenceNames(Call& call) {
  Traversal to(call);
  writeNames(call, to,
             CBReferenceNames(call.manager.broker, call.context, to.source, orNull(to.resultClass), orNull(to.role),
                              &to.status));
}

}  // namespace Cimom::CimXml
