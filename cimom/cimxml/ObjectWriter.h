// SPDX-License-Identifier: Apache-2.0
// Writes paths, instances and values as CIM-XML (DSP0201).
#pragma once

#include <cmpidt.h>

#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "cimom/cimxml/XmlWriter.h"
#include "cimom/model/Instance.h"
#include "cimom/model/Names.h"
#include "cimom/model/ObjectPath.h"
#include "cimom/model/Value.h"

namespace Cimom::CimXml {

// Which properties a client wants to see; names without regard to case.
class PropertyFilter {
 public:
  PropertyFilter() = default;  // all of them
  explicit PropertyFilter(const std::vector<std::string>& names) : names_(std::in_place, names.begin(), names.end()) {}

  bool includes(std::string_view name) const { return !names_ || names_->contains(name); }

 private:
  // Looked up for every property of every instance, and as long as a client likes.
  std::optional<std::set<std::string, NameLess>> names_;
};

class ObjectWriter {
 public:
  // host and nameSpace stand in a path that names none itself.
  ObjectWriter(XmlWriter& xml, const std::string& host, const std::string& nameSpace, PropertyFilter filter = {})
      : xml_(xml), host_(host), nameSpace_(nameSpace), filter_(std::move(filter)) {}

  // INSTANCENAME; a key that is null has no form in CIM-XML and is left out.
  void instanceName(const ObjectPath& path);

  // INSTANCEPATH: with host and namespace.
  void instancePath(const ObjectPath& path);

  // OBJECTPATH.
  void objectPath(const ObjectPath& path);

  // INSTANCE; a property without a value is an empty element.
  void instance(const Cimom::Instance& instance);

  // VALUE.NAMEDINSTANCE.
  void namedInstance(const Cimom::Instance& instance);

  // VALUE.OBJECTWITHPATH.
  void objectWithPath(const Cimom::Instance& instance);

  // VALUE.INSTANCEWITHPATH, which is the same by another name.
  void instanceWithPath(const Cimom::Instance& instance);

  // VALUE, VALUE.ARRAY, VALUE.REFERENCE or VALUE.REFARRAY; nothing for a null value.
  void value(const Cimom::Value& value);

  // The attributes of an element that say of which type its value is: TYPE, or by another name, and what a string with
  // those qualifiers embeds: an instance, or an object of any kind.
  void type(const char* attributeName, CMPIType type, const Qualifiers& qualifiers);

 private:
  void keyBinding(const std::string& name, const Cimom::Value& value);
  void nameSpacePath(const ObjectPath& path);
  void instance(const Cimom::Instance& instance, const ObjectPath& path);
  void embedding(CMPIType type, const Qualifiers& qualifiers);
  void property(const PropertyDeclaration& declaration, const Cimom::Value& value);
  void learn(const ClassDefinition& definition);
  void reference(const ObjectPath& path);
  void withPath(const char* element, const Cimom::Instance& instance);
  void array(const Array& array);
  void text(const Cimom::Value& value);

  // A property as all instances of a class show it that have a value of the declared type.
  struct Frame {
    std::size_t index;  // of the property in its class
    CMPIType type;
    std::string empty;   // what is written of it without a value
    std::size_t middle;  // where the value goes in that
  };

  XmlWriter& xml_;
  const std::string& host_;
  const std::string& nameSpace_;
  PropertyFilter filter_;
  const ClassDefinition* class_ = nullptr;  // of the last instance
  std::vector<Frame> frames_;               // of the class's properties, once there is a second instance of it
};

// LOCALNAMESPACEPATH of "root/cimv2".
void writeLocalNameSpacePath(XmlWriter& xml, std::string_view nameSpace);

}  // namespace Cimom::CimXml
