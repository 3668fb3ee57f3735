// SPDX-License-Identifier: Apache-2.0
#include <algorithm>

#include "cimom/broker/CmpiValue.h"
#include "cimom/broker/Handle.h"
#include "cimom/cimxml/Call.h"
#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

using NameList = std::optional<std::vector<std::string>>;

// Without DeepInheritance a subclass's instance shows what the requested class has, and no more.
NameList visibleProperties(const Call& call, const std::string& className) {
  const NameList list = call.parameters.propertyList();
  const ClassDefinition* definition = call.manager.classes.find(call.request.nameSpace, className);
  if (call.parameters.flag("DeepInheritance", true) || !definition) {
    return list;
  }
  std::vector<std::string> names;
  for (const PropertyDeclaration& property : definition->properties) {
    const auto isProperty = [&property](const std::string& name) { return sameName(name, property.name); };
    if (!list || std::any_of(list->begin(), list->end(), isProperty)) {
      names.push_back(property.name);
    }
  }
  return names;
}

}  // namespace

Found::Found(const Call& call, const CMPIStatus& status, CMPIEnumeration* found, PropertyFilter shown)
    : properties(std::move(shown)) {
  requireOk(status, found);
  objects = std::move(ownModelOf<Enumeration>(found).items);
  call.takeHostOf(objects);
}

Found findInstances(Call& call) {
  const std::string className = call.parameters.requiredClassName("ClassName");
  const NameList list = call.parameters.propertyList();
  PropertyNames names(list);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIEnumeration* instances =
      CBEnumInstances(call.manager.broker, call.context, call.classPath(className), names.get(), &status);
  return {call, status, instances, filterOf(visibleProperties(call, className))};
}

Found findInstanceNames(Call& call) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIObjectPath* path = call.classPath(call.parameters.requiredClassName("ClassName"));
  CMPIEnumeration* names = CBEnumInstanceNames(call.manager.broker, call.context, path, &status);
  return {call, status, names};
}

void enumerateInstances(Call& call) {
  const Found found = findInstances(call);
  const auto scope = call.xml.element("IRETURNVALUE");
  ObjectWriter writer = call.writer(found.properties);
  for (const Cimom::Value& object : found.objects) {
    writer.namedInstance(*object.embedded());
  }
}

void enumerateInstanceNames(Call& call) {
  const Found found = findInstanceNames(call);
  const auto scope = call.xml.element("IRETURNVALUE");
  ObjectWriter writer = call.writer();
  for (const Cimom::Value& object : found.objects) {
    writer.instanceName(*object.path());
  }
}

void getInstance(Call& call) {
  const CMPIObjectPath* path = call.objects.path(call.parameters.instanceName("InstanceName"));
  const NameList list = call.parameters.propertyList();
  PropertyNames names(list);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIInstance* found = CBGetInstance(call.manager.broker, call.context, path, names.get(), &status);
  requireOk(status, found);
  const auto instance = Cimom::Value::instance(heldBy<Cimom::Instance>(found));
  call.takeHostOf({instance});
  const auto scope = call.xml.element("IRETURNVALUE");
  call.writer(filterOf(list)).instance(*instance.embedded());
}

void createInstance(Call& call) {
  const Instance& given = call.parameters.instance("NewInstance");
  const CMPIInstance* instance = call.objects.instance(given);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIObjectPath* created =
      CBCreateInstance(call.manager.broker, call.context, call.objects.path(given.path), instance, &status);
  requireOk(status, created);
  const auto path = Cimom::Value::reference(heldBy<ObjectPath>(created));
  call.takeHostOf({path});
  const auto scope = call.xml.element("IRETURNVALUE");
  call.writer().instanceName(*path.path());
}

void modifyInstance(Call& call) {
  const Instance& given = call.parameters.instance("ModifiedInstance");
  const CMPIObjectPath* path = call.objects.path(given.path);
  const CMPIInstance* instance = call.objects.instance(given);
  const NameList list = call.parameters.propertyList();
  PropertyNames names(list);
  requireOk(CBModifyInstance(call.manager.broker, call.context, path, instance, names.get()));
}

void deleteInstance(Call& call) {
  const CMPIObjectPath* path = call.objects.path(call.parameters.instanceName("InstanceName"));
  requireOk(CBDeleteInstance(call.manager.broker, call.context, path));
}

void getProperty(Call& call) {
  const CMPIObjectPath* path = call.objects.path(call.parameters.instanceName("InstanceName"));
  const std::string name = call.parameters.text("PropertyName").value_or("");
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIData data = CBGetProperty(call.manager.broker, call.context, path, name.c_str(), &status);
  requireOk(status);
  const auto scope = call.xml.element("IRETURNVALUE");
  call.writer().value(fromCmpi(CMIsNullValue(data) ? nullptr : &data.value, data.type));
}

void setProperty(Call& call) {
  const ObjectName& instance = call.parameters.instanceName("InstanceName");
  Property property;
  property.name = call.parameters.text("PropertyName").value_or("");
  if (const Parameter* given = call.parameters.find("NewValue")) {
    std::visit(
        [&property](const auto& value) {
          if constexpr (std::is_constructible_v<Value, decltype(value)>) {
            property.value = value;
          } else {
            throw OperationError(CMPI_RC_ERR_TYPE_MISMATCH,
                                 "parameter NewValue must be a value of the property's type");
          }
        },
        given->value);
  }
  const auto value = call.objects.propertyValue(instance, property);
  requireOk(CBSetProperty(call.manager.broker, call.context, call.objects.path(instance), property.name.c_str(),
                          value.pointer(), value.type));
}

}  // namespace Cimom::CimXml
