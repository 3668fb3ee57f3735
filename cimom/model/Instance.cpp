// SPDX-License-Identifier: Apache-2.0
#include "cimom/model/Instance.h"

#include <algorithm>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom {

Instance::Instance(const ClassDefinition& definition, Shared<ObjectPath> path)
    : definition_(&definition), path_(std::move(path)), values_(definition.properties.size()) {
  takeKeys();
}

const Value& Instance::operator[](std::size_t index) const {
  return isSet(index) ? values_[index] : definition_->properties[index].defaultValue;
}

const Value* Instance::find(std::string_view name) const {
  const PropertyDeclaration* property = definition_->findProperty(name);
  return property ? &(*this)[definition_->properties.indexOf(*property)] : nullptr;
}

void Instance::set(std::string_view name, Value value) {
  const PropertyDeclaration* property = definition_->findProperty(name);
  if (!property) {
    return;
  }
  if (value.isNull()) {
    value = Value::null(property->valueType());
  } else if (value.type() != property->type && value.type() != property->valueType()) {
    throw StatusError(CMPI_RC_ERR_TYPE_MISMATCH, definition_->name + "." + property->name + " must be of type " +
                                                     describeType(property->type) + ", not " +
                                                     describeType(value.type()));
  }
  if (filter_ && !filter_->contains(property->name) && !property->isKey()) {
    return;
  }
  values_[definition_->properties.indexOf(*property)] = std::move(value);
}

void Instance::setFilter(const std::vector<std::string>& properties) {
  filter_.emplace(properties.begin(), properties.end());
}

Shared<ObjectPath> Instance::path() const {
  if (path_->keys.empty()) {
    std::vector<Value> values;
    values.reserve(definition_->keys.size());
    for (const std::size_t index : definition_->keys) {
      values.push_back((*this)[index]);
    }
    if (!values.empty() && std::ranges::none_of(values, &Value::isNull)) {
      return ObjectPath{path_->host, path_->nameSpace, path_->className, {definition_->keyNames, std::move(values)}};
    }
  }
  Shared<ObjectPath> complete = path_;
  for (const std::size_t index : definition_->keys) {
    const std::string& name = definition_->properties[index].name;
    const Value& value = (*this)[index];
    const Value* given = path_->keys.find(name);
    if (!value.isNull() && (!given || given->isNull())) {
      complete.own().keys.set(name, value);
    }
  }
  return complete;
}

void Instance::setPath(Shared<ObjectPath> path) {
  if (!sameName(path->className, definition_->name)) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER,
                      "an instance of " + definition_->name + " cannot have a path of " + path->className);
  }
  path_ = std::move(path);
  takeKeys();
}

Instance Instance::withoutDefaults() const {
  Instance bare = *this;
  for (std::size_t index = 0; index < size(); ++index) {
    if (!bare.isSet(index)) {
      bare.values_[index] = Value::null(definition_->properties[index].type);
    }
  }
  return bare;
}

void Instance::takeKeys() {
  for (const auto& [name, value] : path_->keys) {
    const PropertyDeclaration* property = definition_->findProperty(name);
    if (!property || !property->isKey()) {
      continue;
    }
    if (auto typed = value.as(property->type)) {
      set(name, *std::move(typed));
    }
  }
}

}  // namespace Cimom
