// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/ObjectBuilder.h"

#include <cmpimacs.h>

#include <array>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/ScalarText.h"
#include "cimom/model/Types.h"

namespace Cimom::CimXml {
namespace {

constexpr std::array<CMPIType, 3> numberTypes = {CMPI_sint64, CMPI_uint64, CMPI_real64};

CMPIType numberType(const std::string& text) {
  for (const CMPIType type : numberTypes) {
    if (parseScalar(type, text)) {
      return type;
    }
  }
  return CMPI_string;
}

CMPIType claimedType(const KeyValue& key) {
  if (key.kind == KeyValue::Kind::Reference) {
    return CMPI_ref;
  }
  if (const CMPIType type = typeOfXmlName(key.type)) {
    return type;
  }
  switch (key.kind) {
    case KeyValue::Kind::Boolean:
      return CMPI_boolean;
    case KeyValue::Kind::Numeric:
      return numberType(key.text);
    default:
      return CMPI_string;
  }
}

// A class with one key may be named by the key's value alone.
std::string loneKey(const ClassDefinition* definition, const ObjectName& name) {
  if (!definition || definition->keys.empty()) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "class " + name.className + " has no key");
  }
  if (definition->keys.size() > 1) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER,
                         "class " + name.className + " has more than one key, so each must be named");
  }
  return definition->properties[definition->keys.front()].name;
}

}  // namespace

CMPIObjectPath* ObjectBuilder::path(const ObjectName& name) const {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const std::string& nameSpace = name.nameSpace.empty() ? nameSpace_ : name.nameSpace;
  CMPIObjectPath* path = CMNewObjectPath(broker_, nameSpace.c_str(), name.className.c_str(), &status);
  requireOk(status, path);
  if (!name.host.empty()) {
    requireOk(CMSetHostname(path, name.host.c_str()));
  }
  for (const KeyBinding& key : name.keys) {
    addKey(path, name, key);
  }
  return path;
}

const ClassDefinition* ObjectBuilder::classOf(const ObjectName& name) const {
  return classes_.find(name.nameSpace.empty() ? nameSpace_ : name.nameSpace, name.className);
}

void ObjectBuilder::addKey(CMPIObjectPath* path, const ObjectName& name, const KeyBinding& key) const {
  const ClassDefinition* definition = classOf(name);
  const std::string keyName = key.name.empty() ? loneKey(definition, name) : key.name;
  const PropertyDeclaration* declared = definition ? definition->findProperty(keyName) : nullptr;
  const TypedValue value = keyValue({keyName, key.value}, declared ? declared->type : claimedType(key.value));
  requireOk(CMAddKey(path, keyName.c_str(), value.pointer(), value.type));
}

ObjectBuilder::TypedValue ObjectBuilder::keyValue(const KeyBinding& key, CMPIType type) const {
  TypedValue typed{{}, type, false};
  const bool isReference = key.value.kind == KeyValue::Kind::Reference;
  if (isReference && type == CMPI_ref) {
    typed.value.ref = path(*key.value.reference);
  } else if (isReference || type == CMPI_ref) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER,
                         "key " + key.name + (isReference ? " must not be a reference" : " must be a reference"));
  } else if (!scalar(type, key.value.text, typed.value)) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "key " + key.name + " must be of type " + describeType(type) +
                                                            ", not \"" + key.value.text + "\"");
  }
  return typed;
}

CMPIInstance* ObjectBuilder::instance(const Instance& instance) const {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  ObjectName own = instance.path;
  own.className = instance.className;
  if (!classOf(own) && classOf(instance.path)) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER,
                         "an instance of " + own.className + " cannot have a path of " + instance.path.className);
  }
  CMPIInstance* object = CMNewInstance(broker_, path(own), &status);
  requireOk(status, object);
  for (const Property& property : instance.properties) {
    const TypedValue value = propertyValue(own, property);
    requireOk(CMSetProperty(object, property.name.c_str(), value.pointer(), value.type));
  }
  return object;
}

ObjectBuilder::TypedValue ObjectBuilder::propertyValue(const ObjectName& owner, const Property& property) const {
  const ClassDefinition* definition = classOf(owner);
  if (!definition) {
    throw OperationError(CMPI_RC_ERR_INVALID_CLASS, "unknown class \"" + owner.className + "\"");
  }
  const PropertyDeclaration* declared = definition->findProperty(property.name);
  if (!declared) {
    throw OperationError(CMPI_RC_ERR_NO_SUCH_PROPERTY,
                         "class " + definition->name + " has no property " + property.name);
  }
  return typed("property " + property.name, property, declared->valueType());
}

ObjectBuilder::TypedValue ObjectBuilder::argument(const PropertyDeclaration& declared, const Parameter& given) const {
  Property property{declared.name, given.type, false, {}};
  std::visit(
      [&property](const auto& value) {
        if constexpr (std::is_constructible_v<Value, decltype(value)>) {
          property.value = value;
        }
      },
      given.value);
  const bool isNull = std::holds_alternative<std::monostate>(property.value);
  property.isArray =
      isNull ? isArray(declared.type)
             : std::holds_alternative<Texts>(property.value) || std::holds_alternative<ObjectNames>(property.value);
  try {
    return typed("parameter " + declared.name, property, declared.valueType());
  } catch (const OperationError& error) {
    throw OperationError(
        error.code() == CMPI_RC_ERR_TYPE_MISMATCH ? static_cast<int>(CMPI_RC_ERR_INVALID_PARAMETER) : error.code(),
        error.what());
  }
}

ObjectBuilder::TypedValue ObjectBuilder::typed(const std::string& what, const Property& property, CMPIType type) const {
  const CMPIType elementType = elementTypeOf(type);
  const bool isArray = elementType != type;
  const std::string mustBe = what + " must be of type " + describeType(type);
  TypedValue typed{{}, type, false};
  if (!property.type.empty() && (property.type != xmlTypeName(type) || property.isArray != isArray)) {
    throw OperationError(CMPI_RC_ERR_TYPE_MISMATCH, mustBe + ", not " + property.type + (property.isArray ? "[]" : ""));
  }
  if (const auto* single = std::get_if<std::string>(&property.value); single && !isArray && type != CMPI_ref) {
    text(what, *single, type, typed.value);
  } else if (const auto* texts = std::get_if<Texts>(&property.value); texts && isArray && elementType != CMPI_ref) {
    typed.value.array = array(*texts, elementType, [&](CMPICount index, const std::string& one, CMPIValue& value) {
      text("element " + std::to_string(index) + " of " + what, one, elementType, value);
    });
  } else if (const auto* name = std::get_if<ObjectName>(&property.value); name && type == CMPI_ref) {
    typed.value.ref = path(*name);
  } else if (const auto* names = std::get_if<ObjectNames>(&property.value);
             names && isArray && elementType == CMPI_ref) {
    typed.value.array =
        array(*names, elementType, [&](CMPICount, const ObjectName& one, CMPIValue& value) { value.ref = path(one); });
  } else if (std::holds_alternative<std::monostate>(property.value)) {
    typed.isNull = true;
  } else {
    throw OperationError(CMPI_RC_ERR_TYPE_MISMATCH, mustBe);
  }
  return typed;
}

template <typename Elements, typename Read>
CMPIArray* ObjectBuilder::array(const Elements& elements, CMPIType elementType, Read read) const {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIArray* array = CMNewArray(broker_, static_cast<CMPICount>(elements.size()), elementType, &status);
  requireOk(status, array);
  for (CMPICount i = 0; i < elements.size(); ++i) {
    if (!elements[i]) {
      continue;  // an element is null until it is set
    }
    CMPIValue value{};
    read(i, *elements[i], value);
    requireOk(CMSetArrayElementAt(array, i, &value, elementType));
  }
  return array;
}

void ObjectBuilder::text(const std::string& what, const std::string& text, CMPIType type, CMPIValue& value) const {
  if (type == CMPI_instance) {
    value.inst = embedded(what, text);
  } else if (!scalar(type, text, value)) {
    throw OperationError(CMPI_RC_ERR_TYPE_MISMATCH,
                         what + " must be of type " + describeType(type) + ", not \"" + text + "\"");
  }
}

CMPIInstance* ObjectBuilder::embedded(const std::string& what, const std::string& text) const {
  // Far more than any class has.
  constexpr unsigned deepest = 16;
  if (depth_ == deepest) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER,
                         "instances are embedded more than " + std::to_string(deepest) + " levels deep");
  }
  ObjectBuilder within = *this;
  ++within.depth_;
  try {
    return within.instance(readEmbeddedInstance(text));
  } catch (const TransportError& error) {
    throw OperationError(CMPI_RC_ERR_TYPE_MISMATCH, what + " must be the text of an INSTANCE: " + error.what());
  }
}

bool ObjectBuilder::scalar(CMPIType type, const std::string& text, CMPIValue& value) const {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  if (type == CMPI_string) {
    value.string = CMNewString(broker_, text.c_str(), &status);
    return status.rc == CMPI_RC_OK;
  }
  if (type == CMPI_dateTime) {
    value.dateTime = CMNewDateTimeFromChars(broker_, text.c_str(), &status);
    return status.rc == CMPI_RC_OK && value.dateTime;
  }
  const auto parsed = parseScalar(type, text);
  if (parsed) {
    value = *parsed;
  }
  return parsed.has_value();
}

}  // namespace Cimom::CimXml
