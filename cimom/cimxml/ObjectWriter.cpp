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
  if (class_ != &object.definition()) {
    class_ = &object.definition();
    frames_.clear();
    for (std::size_t index = 0; index < properties.size(); ++index) {
      if (filter_.includes(properties[index].name)) {
        property(properties[index], object[index]);
      }
    }
    return;
  }
  if (frames_.empty()) {
    learn(object.definition());
  }
  for (const Frame& frame : frames_) {
    const Cimom::Value& given = object[frame.index];
    const std::string_view empty = frame.empty;
    if (given.isNull()) {
      xml_.written(empty);
    } else if (given.type() != frame.type) {
      property(properties[frame.index], given);
    } else {
      xml_.written(empty.substr(0, frame.middle));
      value(given);
      xml_.written(empty.substr(frame.middle));
    }
  }
}

// Nearly all that is written of a property is the same for each instance.
void ObjectWriter::learn(const ClassDefinition& definition) {
  XmlWriter xml(XmlWriter::Prolog::None);
  ObjectWriter writer(xml, host_, nameSpace_);
  const auto& properties = definition.properties;
  frames_.reserve(properties.size());
  for (std::size_t index = 0; index < properties.size(); ++index) {
    if (!filter_.includes(properties[index].name)) {
      continue;
    }
    writer.property(properties[index], Cimom::Value());
    std::string empty = xml.take();
    if (const std::size_t middle = empty.rfind('<'); middle != std::string::npos) {
      frames_.push_back({index, properties[index].valueType(), std::move(empty), middle});
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
    xml_.written("<VALUE>");
    text(value);
    xml_.written("</VALUE>");
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
