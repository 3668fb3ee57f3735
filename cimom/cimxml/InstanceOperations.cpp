// SPDX-License-Identifier: Apache-2.0
#include <algorithm>

#include "cimom/cimxml/Call.h"
#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

using NameList = std::optional<std::vector<std::string>>;

// Without DeepInheritance a subclass's instance shows what the requested class has, and no more.
NameList visibleProperties(const Call& call, const std::string& className) {
  const NameList list = call.parameters.propertyList();
  const ClassDefinition* definition = call.manager.classes.find(className);
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

Found::Found(const CMPIStatus& status, CMPIEnumeration* found, PropertyFilter shown)
    : objects(found), properties(std::move(shown)) {
  requireOk(status, found);
}

Found findInstances(Call& call) {
  const std::string className = call.parameters.requiredClassName("ClassName");
  const NameList list = call.parameters.propertyList();
  PropertyNames names(list);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIEnumeration* instances =
      CBEnumInstances(call.manager.broker, call.context, call.classPath(className), names.get(), &status);
  return {status, instances, filterOf(visibleProperties(call, className))};
}

Found findInstanceNames(Call& call) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIObjectPath* path = call.classPath(call.parameters.requiredClassName("ClassName"));
  CMPIEnumeration* names = CBEnumInstanceNames(call.manager.broker, call.context, path, &status);
  return {status, names};
}

void enumerateInstances(Call& call) {
  const Found found = findInstances(call);
  const auto scope = call.xml.element("IRETURNVALUE");
  ObjectWriter writer = call.writer(found.properties);
  forEachObject(found, [&writer](const CMPIValue& value) { writer.namedInstance(value.inst); });
}

void enumerateInstanceNames(Call& call) {
  const Found found = findInstanceNames(call);
  const auto scope = call.xml.element("IRETURNVALUE");
  ObjectWriter writer = call.writer();
  forEachObject(found, [&writer](const CMPIValue& value) { writer.instanceName(value.ref); });
}

void getInstance(Call& call) {
  const CMPIObjectPath* path = call.objects.path(call.parameters.instanceName("InstanceName"));
  const NameList list = call.parameters.propertyList();
  PropertyNames names(list);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIInstance* instance = CBGetInstance(call.manager.broker, call.context, path, names.get(), &status);
  requireOk(status, instance);
  const auto scope = call.xml.element("IRETURNVALUE");
  call.writer(filterOf(list)).instance(instance);
}

void createInstance(Call& call) {
  const Instance& given = call.parameters.instance("NewInstance");
  const CMPIInstance* instance = call.objects.instance(given);
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIObjectPath* path =
      CBCreateInstance(call.manager.broker, call.context, call.objects.path(given.path), instance, &status);
  requireOk(status, path);
  const auto scope = call.xml.element("IRETURNVALUE");
  call.writer().instanceName(path);
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
  call.writer().value(data);
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
          }
        },
        given->value);
  }
  const auto value = call.objects.propertyValue(instance.className, property);
  requireOk(CBSetProperty(call.manager.broker, call.context, call.objects.path(instance), property.name.c_str(),
                          value.pointer(), value.type));
}

}  // namespace Cimom::CimXml
