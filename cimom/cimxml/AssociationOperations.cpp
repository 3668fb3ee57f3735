// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Call.h"

namespace Cimom::CimXml {
namespace {

// What every traversal takes. DSP0200 lets it start from a class too; that asks the schema, which this server does not.
struct Traversal {
  Traversal(const Call& call, std::string_view sourceParameter)
      : assocClass(call.parameters.className("AssocClass")),
        resultClass(call.parameters.className("ResultClass")),
        role(call.parameters.text("Role").value_or("")),
        resultRole(call.parameters.text("ResultRole").value_or("")),
        list(call.parameters.propertyList()),
        names(list) {
    const ObjectName& name = call.parameters.instanceName(sourceParameter);
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

void writeInstances(const Call& call, const Found& found) {
  const auto scope = call.xml.element("IRETURNVALUE");
  ObjectWriter writer = call.writer(found.properties);
  for (const Cimom::Value& object : found.objects) {
    writer.objectWithPath(*object.embedded());
  }
}

void writeNames(const Call& call, const Found& found) {
  const auto scope = call.xml.element("IRETURNVALUE");
  ObjectWriter writer = call.writer();
  for (const Cimom::Value& object : found.objects) {
    writer.objectPath(*object.path());
  }
}

}  // namespace

Found findAssociators(Call& call, std::string_view source) {
  Traversal to(call, source);
  CMPIEnumeration* instances =
      CBAssociators(call.manager.broker, call.context, to.source, orNull(to.assocClass), orNull(to.resultClass),
                    orNull(to.role), orNull(to.resultRole), to.names.get(), &to.status);
  return {call, to.status, instances, filterOf(to.list)};
}

Found findAssociatorNames(Call& call, std::string_view source) {
  Traversal to(call, source);
  CMPIEnumeration* names =
      CBAssociatorNames(call.manager.broker, call.context, to.source, orNull(to.assocClass), orNull(to.resultClass),
                        orNull(to.role), orNull(to.resultRole), &to.status);
  return {call, to.status, names};
}

Found findReferences(Call& call, std::string_view source) {
  Traversal to(call, source);
  CMPIEnumeration* instances = CBReferences(call.manager.broker, call.context, to.source, orNull(to.resultClass),
                                            orNull(to.role), to.names.get(), &to.status);
  return {call, to.status, instances, filterOf(to.list)};
}

Found findReferenceNames(Call& call, std::string_view source) {
  Traversal to(call, source);
  CMPIEnumeration* names = CBReferenceNames(call.manager.broker, call.context, to.source, orNull(to.resultClass),
                                            orNull(to.role), &to.status);
  return {call, to.status, names};
}

void associators(Call& call) { writeInstances(call, findAssociators(call, "ObjectName")); }

void associatorNames(Call& call) { writeNames(call, findAssociatorNames(call, "ObjectName")); }

void references(Call& call) { writeInstances(call, findReferences(call, "ObjectName")); }

void referenceNames(Call& call) { writeNames(call, findReferenceNames(call, "ObjectName")); }

}  // namespace Cimom::CimXml
