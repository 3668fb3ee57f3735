// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/ObjectWriter.h"

#include <cmpimacs.h>

#include <algorithm>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/ScalarText.h"
#include "cimom/model/Types.h"

namespace Cimom::CimXml {
namespace {

const char* chars(const CMPIString* string) {
  const char* text = string ? CMGetCharsPtr(string, nullptr) : nullptr;
  return text ? text : "";
}

// Object managers and providers mark a missing value by the state, by the type or by the pointer alone.
bool isNull(const CMPIData& data) {
  if (CMIsNullValue(data) || data.type == CMPI_null) {
    return true;
  }
  const bool isPointer = data.type >= CMPI_ENC;
  return isPointer && !data.value.dataPtr.ptr;
}

const CMPIObjectPath* pathOf(const CMPIInstance* instance) {
  const CMPIObjectPath* path = CMGetObjectPath(instance, nullptr);
  if (!path) {
    throw OperationError(CMPI_RC_ERR_FAILED, "the provider returned an instance without a path");
  }
  return path;
}

ObjectWriter::Embedding embeddingOf(const CMPIObjectPath* path, const char* property) {
  const CMPIData qualifier = CMGetPropertyQualifier(path, property, "EmbeddedObject", nullptr);
  const bool isObject = qualifier.type == CMPI_boolean && !CMIsNullValue(qualifier) && qualifier.value.boolean;
  return isObject ? ObjectWriter::Embedding::Object : ObjectWriter::Embedding::Instance;
}

}  // namespace

void ObjectWriter::instanceName(const CMPIObjectPath* path) {
  const auto name = xml_.element("INSTANCENAME", "CLASSNAME", chars(CMGetClassName(path, nullptr)));
  const CMPICount count = CMGetKeyCount(path, nullptr);
  for (CMPICount i = 0; i < count; ++i) {
    CMPIString* keyName = nullptr;
    const CMPIData data = CMGetKeyAt(path, i, &keyName, nullptr);
    if (!isNull(data)) {
      keyBinding(chars(keyName), data);
    }
  }
}

void ObjectWriter::keyBinding(const char* name, const CMPIData& data) {
  const auto binding = xml_.element("KEYBINDING", "NAME", name);
  if (data.type == CMPI_ref) {
    reference(data.value.ref);
    return;
  }
  const auto value = xml_.element("KEYVALUE", "VALUETYPE", keyValueType(data.type));
  if (const char* type = xmlTypeName(data.type)) {
    xml_.attribute("TYPE", type);
  }
  xml_.text(scalar(data.type, data.value));
}

void ObjectWriter::instancePath(const CMPIObjectPath* path) {
  const auto scope = xml_.element("INSTANCEPATH");
  nameSpacePath(path);
  instanceName(path);
}

void ObjectWriter::nameSpacePath(const CMPIObjectPath* path) {
  const auto scope = xml_.element("NAMESPACEPATH");
  const std::string_view host = chars(CMGetHostname(path, nullptr));
  const std::string_view nameSpace = chars(CMGetNameSpace(path, nullptr));
  xml_.textElement("HOST", host.empty() ? host_ : host);
  writeLocalNameSpacePath(xml_, nameSpace.empty() ? nameSpace_ : nameSpace);
}

void ObjectWriter::objectPath(const CMPIObjectPath* path) {
  const auto scope = xml_.element("OBJECTPATH");
  instancePath(path);
}

void ObjectWriter::instance(const CMPIInstance* instance) {
  const CMPIObjectPath* path = pathOf(instance);
  const auto scope = xml_.element("INSTANCE", "CLASSNAME", chars(CMGetClassName(path, nullptr)));
  const CMPICount count = CMGetPropertyCount(instance, nullptr);
  for (CMPICount i = 0; i < count; ++i) {
    CMPIString* name = nullptr;
    const CMPIData data = CMGetPropertyAt(instance, i, &name, nullptr);
    if (filter_.includes(chars(name))) {
      property(path, chars(name), data);
    }
  }
}

void ObjectWriter::property(const CMPIObjectPath* path, const char* name, const CMPIData& data) {
  if (data.type == CMPI_ref) {
    const auto scope = xml_.element("PROPERTY.REFERENCE", "NAME", name);
    value(data);
    return;
  }
  if (!xmlTypeName(data.type)) {
    return;
  }
  const auto scope = xml_.element(CMIsArray(data) ? "PROPERTY.ARRAY" : "PROPERTY", "NAME", name);
  const bool isEmbedded = elementTypeOf(data.type) == CMPI_instance;
  type("TYPE", data.type, isEmbedded ? embeddingOf(path, name) : Embedding::Instance);
  value(data);
}

void ObjectWriter::type(const char* attributeName, CMPIType type, Embedding embedding) {
  if (const char* name = xmlTypeName(type)) {
    xml_.attribute(attributeName, name);
  }
  if (elementTypeOf(type) == CMPI_instance) {
    xml_.attribute("EmbeddedObject", embedding == Embedding::Object ? "object" : "instance");
  }
}

void ObjectWriter::namedInstance(const CMPIInstance* object) {
  const auto scope = xml_.element("VALUE.NAMEDINSTANCE");
  instanceName(pathOf(object));
  instance(object);
}

void ObjectWriter::objectWithPath(const CMPIInstance* object) { withPath("VALUE.OBJECTWITHPATH", object); }

void ObjectWriter::instanceWithPath(const CMPIInstance* object) { withPath("VALUE.INSTANCEWITHPATH", object); }

void ObjectWriter::withPath(const char* element, const CMPIInstance* object) {
  const auto scope = xml_.element(element);
  instancePath(pathOf(object));
  instance(object);
}

void ObjectWriter::value(const CMPIData& data) {
  if (isNull(data)) {
    return;
  }
  if (CMIsArray(data)) {
    array(data);
  } else if (data.type == CMPI_ref) {
    reference(data.value.ref);
  } else {
    xml_.textElement("VALUE", scalar(data.type, data.value));
  }
}

void ObjectWriter::reference(const CMPIObjectPath* path) {
  const auto scope = xml_.element("VALUE.REFERENCE");
  instancePath(path);
}

void ObjectWriter::array(const CMPIData& data) {
  const bool isReferences = elementTypeOf(data.type) == CMPI_ref;
  const auto scope = xml_.element(isReferences ? "VALUE.REFARRAY" : "VALUE.ARRAY");
  const CMPICount count = CMGetArrayCount(data.value.array, nullptr);
  for (CMPICount i = 0; i < count; ++i) {
    const CMPIData element = CMGetArrayElementAt(data.value.array, i, nullptr);
    if (isNull(element)) {
      const auto null = xml_.element("VALUE.NULL");
    } else if (isReferences) {
      reference(element.value.ref);
    } else {
      xml_.textElement("VALUE", scalar(element.type, element.value));
    }
  }
}

// An embedded instance is the text of its own XML.
std::string ObjectWriter::scalar(CMPIType type, const CMPIValue& value) const {
  if (type != CMPI_instance) {
    return formatScalar(type, value);
  }
  XmlWriter xml(XmlWriter::Prolog::None);
  ObjectWriter(xml, host_, nameSpace_).instance(value.inst);
  return xml.take();
}

void writeLocalNameSpacePath(XmlWriter& xml, std::string_view nameSpace) {
  const auto path = xml.element("LOCALNAMESPACEPATH");
  while (!nameSpace.empty()) {
    const std::string_view part = nameSpace.substr(0, nameSpace.find('/'));
    if (!part.empty()) {
      const auto scope = xml.element("NAMESPACE", "NAME", part);
    }
    nameSpace.remove_prefix(std::min(part.size() + 1, nameSpace.size()));
  }
}

}  // namespace Cimom::CimXml
