// SPDX-License-Identifier: Apache-2.0
// CIM values: single, in arrays, and by name.
#pragma once

#include <cmpidt.h>

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

#include "cimom/model/DateTime.h"
#include "cimom/model/Shared.h"

namespace Cimom {

struct Array;
class NamedValues;
struct ObjectPath;
class Instance;

// A typed CIM value, possibly null: what properties, keys, arguments and array elements hold. Values of object types
// are copies: nothing that happens to the object that they were taken from changes them. A copy shares what it holds,
// so that copying never throws.
class Value {
 public:
  // Null, of no type.
  Value() = default;

  static Value null(CMPIType type);
  static Value boolean(bool value);
  static Value uint32(CMPIUint32 value);
  static Value uint64(CMPIUint64 value);
  static Value sint64(CMPISint64 value);
  static Value real64(CMPIReal64 value);
  static Value char16(CMPIChar16 value);
  // Of any type that CMPI passes by value.
  static Value scalar(CMPIType type, const CMPIValue& value);
  static Value string(std::string value);
  static Value string(Shared<std::string> value);
  static Value dateTime(DateTime value);
  static Value reference(Shared<ObjectPath> value);
  static Value instance(Shared<Instance> value);
  static Value array(Shared<Array> value);
  // What only CMPI passes as a value: arguments of a method, and items of an enumeration.
  static Value arguments(NamedValues value);
  static Value enumeration(std::vector<Value> items);

  CMPIType type() const { return type_; }
  bool isNull() const { return std::holds_alternative<std::monostate>(content_); }
  // Whether this is the boolean TRUE.
  bool isTrue() const;

  // A value of a type that CMPI passes by value, or null.
  const CMPIValue* scalar() const { return std::get_if<CMPIValue>(&content_); }
  // The text of a CMPI_string, or null.
  const std::string* text() const;
  // The time stamp or interval of a CMPI_dateTime, or null.
  const DateTime* time() const { return std::get_if<DateTime>(&content_); }
  // The path of a reference, or null.
  const ObjectPath* path() const;
  // The embedded instance, or the instance of a result, or null.
  const Instance* embedded() const;
  // The array, or null.
  const Array* elements() const;
  // The arguments, or null.
  const NamedValues* arguments() const;
  // The items of the enumeration, or null.
  const std::vector<Value>* items() const;
  // The text, path, instance or array as this value shares it, or null.
  template <typename T>
  const Shared<T>* shared() const {
    return std::get_if<Shared<T>>(&content_);
  }
  // The path or instance, to be changed in this value alone, or null.
  template <typename T>
  T* own() {
    auto* object = std::get_if<Shared<T>>(&content_);
    return object ? &object->own() : nullptr;
  }

  // The same number as another integer type; none if it is no integer or does not fit.
  std::optional<Value> asInteger(CMPIType type) const;
  // The same value as `type`: itself if it has that type, a null of it, or the same number; none otherwise.
  std::optional<Value> as(CMPIType type) const;

  // The value as a key of an untyped WBEM URI (DSP0207) writes it: numbers and TRUE/FALSE bare, all else in quotes.
  std::string toString() const;

 private:
  using Content = std::variant<std::monostate, CMPIValue, DateTime, Shared<std::string>, Shared<ObjectPath>,
                               Shared<Instance>, Shared<Array>, Shared<NamedValues>, Shared<std::vector<Value>>>;

  // What a variant does whose copy throws is not to be relied on.
  template <typename... Types>
  static constexpr bool copiesWithoutThrowing(const std::variant<Types...>*) {
    return (std::is_nothrow_copy_constructible_v<Types> && ...);
  }

  Value(CMPIType type, Content content);

  template <typename T>
  const T* object() const;

  CMPIType type_ = CMPI_null;
  Content content_;
};

// A CIM array: elements of one type, each of which may be null.
struct Array {
  CMPIType elementType = CMPI_null;
  std::vector<Value> elements;
};

// Values by name in the order in which they came: the keys of a path, the arguments of a method, the entries of a
// context. Names are looked up without regard to case and keep the spelling that they were first given with.
class NamedValues {
 public:
  using Names = std::vector<std::string>;

  struct Entry {
    const std::string& name;
    const Value& value;
  };

  class Iterator {
   public:
    using value_type = Entry;
    using difference_type = std::ptrdiff_t;

    Iterator() = default;
    Iterator(const NamedValues& values, std::size_t index) : values_(&values), index_(index) {}

    Entry operator*() const { return (*values_)[index_]; }
    Iterator& operator++() {
      ++index_;
      return *this;
    }
    Iterator operator++(int) { return {*values_, index_++}; }
    bool operator==(const Iterator&) const = default;

   private:
    const NamedValues* values_ = nullptr;
    std::size_t index_ = 0;
  };

  NamedValues() = default;
  // One value for each of the names, which are shared with others that have the same: paths of one class.
  NamedValues(Shared<Names> names, std::vector<Value> values) : shared_(std::move(names)), values_(std::move(values)) {}

  const Value* find(std::string_view name) const;
  void set(std::string_view name, Value value);

  std::size_t size() const { return values_.size(); }
  bool empty() const { return values_.empty(); }
  Entry operator[](std::size_t index) const { return {names()[index], values_[index]}; }
  Iterator begin() const { return {*this, 0}; }
  Iterator end() const { return {*this, size()}; }

 private:
  const Names& names() const { return shared_ ? **shared_ : own_; }

  Names own_;
  std::optional<Shared<Names>> shared_;  // in their place
  std::vector<Value> values_;
};

}  // namespace Cimom
