// SPDX-License-Identifier: Apache-2.0
// Writes CMPI objects as CIM-XML (DSP0201).
#pragma once

#include <cmpidt.h>

#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "cimom/cimxml/XmlWriter.h"
#include "cimom/model/Names.h"

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
  void instanceName(const CMPIObjectPath* path);

  // INSTANCEPATH: with host and namespace.
  void instancePath(const CMPIObjectPath* path);

  // OBJECTPATH.
  void objectPath(const CMPIObjectPath* path);

  // INSTANCE; a property without a value is an empty element.
  void instance(const CMPIInstance* instance);

  // VALUE.NAMEDINSTANCE.
  void namedInstance(const CMPIInstance* instance);

  // VALUE.OBJECTWITHPATH.
  void objectWithPath(const CMPIInstance* instance);

  // VALUE.INSTANCEWITHPATH, which is the same by another name.
  void instanceWithPath(const CMPIInstance* instance);

  // VALUE, VALUE.ARRAY, VALUE.REFERENCE or VALUE.REFARRAY; nothing for a null value.
  void value(const CMPIData& data);

  // What a string that embeds an instance is declared to embed: that, or an object of any kind.
  enum class Embedding { Instance, Object };

  // The attributes of an element that say of which type its value is: TYPE, or by another name, and what a string
  // embeds.
  void type(const char* attributeName, CMPIType type, Embedding embedding);

 private:
  void keyBinding(const char* name, const CMPIData& data);
  void nameSpacePath(const CMPIObjectPath* path);
  void property(const CMPIObjectPath* path, const char* name, const CMPIData& data);
  void reference(const CMPIObjectPath* path);
  void withPath(const char* element, const CMPIInstance* instance);
  void array(const CMPIData& data);
  std::string scalar(CMPIType type, const CMPIValue& value) const;

  XmlWriter& xml_;
  const std::string& host_;
  const std::string& nameSpace_;
  PropertyFilter filter_;
};

// LOCALNAMESPACEPATH of "root/cimv2".
void writeLocalNameSpacePath(XmlWriter& xml, std::string_view nameSpace);

}  // namespace Cimom::CimXml
