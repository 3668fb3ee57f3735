// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/model/ClassDefinition.h"
#include "cimom/model/Names.h"
#include "cimom/model/ObjectPath.h"
#include "cimom/model/Shared.h"

namespace Cimom {

// An instance: a path, and a value for every property that its class declares. A property that nobody set shows the
// class's default.
class Instance {
 public:
  // Keys of the path become values of the key properties.
  Instance(const ClassDefinition& definition, Shared<ObjectPath> path);

  const ClassDefinition& definition() const { return *definition_; }

  // How many properties the class declares.
  std::size_t size() const { return values_.size(); }
  // The value of the class's property of that index.
  const Value& operator[](std::size_t index) const;
  // The value of a property; null if the class declares none of that name.
  const Value* find(std::string_view name) const;

  // Sets a property. A property that the class does not declare, or that the filter leaves out, is dropped.
  // Throws StatusError CMPI_RC_ERR_TYPE_MISMATCH if the value's type is not the declared one.
  void set(std::string_view name, Value value);

  // From now on only the named properties and the keys take a value.
  void setFilter(const std::vector<std::string>& properties);

  // The path with every key that has a value: one given with the path wins over the property's value.
  Shared<ObjectPath> path() const;
  // Replaces the path; its keys become values of the key properties.
  // Throws StatusError CMPI_RC_ERR_INVALID_PARAMETER if it is the path of another class.
  void setPath(Shared<ObjectPath> path);

  // The same instance, in which a property that nobody set is null, as ModifyInstance hands it to a provider.
  Instance withoutDefaults() const;

 private:
  bool isSet(std::size_t index) const { return values_[index].type() != CMPI_null; }
  void takeKeys();

  const ClassDefinition* definition_;
  Shared<ObjectPath> path_;
  std::vector<Value> values_;  // one of no type: nobody has set it
  std::optional<std::set<std::string, NameLess>> filter_;
};

}  // namespace Cimom
