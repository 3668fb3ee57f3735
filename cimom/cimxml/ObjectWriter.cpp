// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/ObjectWriter.h"

#include <algorithm>

#include "cimom/cimxml/ScalarText.h"
#include "cimom/model/Types.h"

namespace Cimom::CimXml {

void ObjectWriter::instanceName(const ObjectPath& path) {
  const auto name = xml_.element("INSTANCENAME", "CLASSNAME", path.className);
  for (const auto& [keyName, value] : path.keys) {
    if (!value.isNull()) {
      keyBinding(keyName, value);
    }
  }
}

void ObjectWriter::keyBinding(const std::string& name, const Cimom::Value& value) {
  const auto binding = xml_.element("KEYBINDING", "NAME", name);
  if (const ObjectPath* path = value.path()) {
    reference(*path);
    return;
  }
  const auto keyValue = xml_.element("KEYVALUE");
  xml_.plainAttribute("VALUETYPE", keyValueType(value.type()));
  if (const char* type = xmlTypeName(value.type())) {
    xml_.plainAttribute("TYPE", type);
  }
  text(value);
}

void ObjectWriter::instancePath(const ObjectPath& path) {
  const auto scope = xml_.element("INSTANCEPATH");
  nameSpacePath(path);
  instanceName(path);
}

void ObjectWriter::nameSpacePath(const ObjectPath& path) {
  const auto scope = xml_.element("NAMESPACEPATH");
  xml_.textElement("HOST", path.host.empty() ? host_ : path.host);
  writeLocalNameSpacePath(xml_, path.nameSpace.empty() ? nameSpace_ : path.nameSpace);
}

void ObjectWriter::objectPath(const ObjectPath& path) {
  const auto scope = xml_.element("OBJECTPATH");
  instancePath(path);
}

void ObjectWriter::instance(const Cimom::Instance& object) { instance(object, *object.path()); }

void ObjectWriter::instance(const Cimom::Instance& object, const ObjectPath& path) {
  const auto scope = xml_.element("INSTANCE", "CLASSNAME", path.className);
  const auto& properties = object.definition().properties;
  for (std::size_t index = 0; index < properties.size(); ++index) {
    if (filter_.includes(properties[index].name)) {
      property(properties[index], object[index]);
    }
  }
}

void ObjectWriter::property(const PropertyDeclaration& declaration, const Cimom::Value& given) {
  const CMPIType valueType = given.isNull() ? declaration.valueType() : given.type();
  const char* typeName = xmlTypeName(valueType);
  if (!typeName) {
    return;
  }
  const bool isReference = valueType == CMPI_ref;
  const auto scope = xml_.element(isReference          ? "PROPERTY.REFERENCE"
                                  : isArray(valueType) ? "PROPERTY.ARRAY"
                                                       : "PROPERTY");
  xml_.plainAttribute("NAME", declaration.name);
  if (!isReference) {
    xml_.plainAttribute("TYPE", typeName);
    embedding(valueType, declaration.qualifiers);
  }
  value(given);
}

void ObjectWriter::type(const char* attributeName, CMPIType type, const Qualifiers& qualifiers) {
  if (const char* name = xmlTypeName(type)) {
    xml_.plainAttribute(attributeName, name);
  }
  embedding(type, qualifiers);
}

void ObjectWriter::embedding(CMPIType type, const Qualifiers& qualifiers) {
  if (elementTypeOf(type) == CMPI_instance) {
    xml_.plainAttribute("EmbeddedObject", isQualified(qualifiers, "EmbeddedObject") ? "object" : "instance");
  }
}

void ObjectWriter::namedInstance(const Cimom::Instance& object) {
  const auto scope = xml_.element("VALUE.NAMEDINSTANCE");
  const Shared<ObjectPath> path = object.path();
  instanceName(*path);
  instance(object, *path);
}

void ObjectWriter::objectWithPath(const Cimom::Instance& object) { withPath("VALUE.OBJECTWITHPATH", object); }

void ObjectWriter::instanceWithPath(const Cimom::Instance& object) { withPath("VALUE.INSTANCEWITHPATH", object); }

void ObjectWriter::withPath(const char* element, const Cimom::Instance& object) {
  const auto scope = xml_.element(element);
  const Shared<ObjectPath> path = object.path();
  instancePath(*path);
  instance(object, *path);
}

void ObjectWriter::value(const Cimom::Value& value) {
  if (value.isNull()) {
    return;
  }
  if (const Array* elements = value.elements()) {
    array(*elements);
  } else if (const ObjectPath* path = value.path()) {
    reference(*path);
  } else {
    const auto scope = xml_.element("VALUE");
    text(value);
  }
}

void ObjectWriter::reference(const ObjectPath& path) {
  const auto scope = xml_.element("VALUE.REFERENCE");
  instancePath(path);
}

void ObjectWriter::array(const Array& array) {
  const auto scope = xml_.element(array.elementType == CMPI_ref ? "VALUE.REFARRAY" : "VALUE.ARRAY");
  for (const Cimom::Value& element : array.elements) {
    if (element.isNull()) {
      const auto null = xml_.element("VALUE.NULL");
    } else {
      value(element);
    }
  }
}

// The text of a value that is neither a reference nor an array.
void ObjectWriter::text(const Cimom::Value& value) {
  if (const std::string* characters = value.text()) {
    xml_.text(characters->c_str());  // to a client a text ends where it does to a provider in C
  } else if (const Cimom::Instance* embedded = value.embedded()) {
    XmlWriter xml(XmlWriter::Prolog::None);
    ObjectWriter(xml, host_, nameSpace_).instance(*embedded);
    xml_.text(xml.take());
  } else {
    xml_.text(formatScalar(value));
  }
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
