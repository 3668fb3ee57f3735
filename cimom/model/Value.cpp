// SPDX-License-Identifier: Apache-2.0
#include "cimom/model/Value.h"

#include <cstring>
#include <type_traits>
#include <utility>

#include "cimom/model/Instance.h"
#include "cimom/model/Names.h"
#include "cimom/model/ObjectPath.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

template <typename T>
CMPIValue scalarOf(T value) {
  CMPIValue content = {};
  std::memcpy(&content, &value, sizeof value);
  return content;
}

// Calls `operation` with the integer; nothing happens to a value of any other type.
template <typename Union, typename Operation>
void visitInteger(CMPIType type, Union& value, Operation operation) {
  visitNumber(type, value, [&](auto& number) {
    if constexpr (std::is_integral_v<std::remove_reference_t<decltype(number)>>) {
      operation(number);
    }
  });
}

std::string inQuotes(std::string_view text) {
  std::string result;
  result.reserve(text.size() + 2);
  result += '"';
  for (const char letter : text) {
    if (letter == '"' || letter == '\\') {
      result += '\\';
    }
    result += letter;
  }
  result += '"';
  return result;
}

// Every level of references within references would double the text of the innermost.
std::string shortened(std::string text) {
  constexpr std::size_t most = 4096;
  if (text.size() > most) {
    std::size_t end = most;
    while (end > 0 && (static_cast<unsigned char>(text[end]) & 0xC0) == 0x80) {
      --end;  // not within a character of UTF-8
    }
    text.resize(end);
    text += "…";
  }
  return text;
}

}  // namespace

Value::Value(CMPIType type, Content content) : type_(type), content_(std::move(content)) {
  static_assert(copiesWithoutThrowing(static_cast<const Content*>(nullptr)));
}

Value Value::null(CMPIType type) { return Value(type, {}); }
Value Value::boolean(bool value) { return Value(CMPI_boolean, scalarOf<CMPIBoolean>(value)); }
Value Value::uint32(CMPIUint32 value) { return Value(CMPI_uint32, scalarOf(value)); }
Value Value::uint64(CMPIUint64 value) { return Value(CMPI_uint64, scalarOf(value)); }
Value Value::sint64(CMPISint64 value) { return Value(CMPI_sint64, scalarOf(value)); }
Value Value::real64(CMPIReal64 value) { return Value(CMPI_real64, scalarOf(value)); }
Value Value::char16(CMPIChar16 value) { return Value(CMPI_char16, scalarOf(value)); }
Value Value::scalar(CMPIType type, const CMPIValue& value) { return Value(type, value); }
Value Value::string(std::string value) { return string(Shared<std::string>(std::move(value))); }
Value Value::string(Shared<std::string> value) { return Value(CMPI_string, std::move(value)); }
Value Value::dateTime(DateTime value) { return Value(CMPI_dateTime, value); }
Value Value::reference(Shared<ObjectPath> value) { return Value(CMPI_ref, std::move(value)); }
Value Value::instance(Shared<Instance> value) { return Value(CMPI_instance, std::move(value)); }
Value Value::array(Shared<Array> value) {
  const CMPIType type = arrayOf(value->elementType);
  return Value(type, std::move(value));
}
Value Value::arguments(NamedValues value) { return Value(CMPI_args, Shared<NamedValues>(std::move(value))); }
Value Value::enumeration(std::vector<Value> items) {
  return Value(CMPI_enumeration, Shared<std::vector<Value>>(std::move(items)));
}

bool Value::isTrue() const {
  const CMPIValue* content = scalar();
  return type_ == CMPI_boolean && content && content->boolean;
}

const std::string* Value::text() const { return object<std::string>(); }
const ObjectPath* Value::path() const { return object<ObjectPath>(); }
const Instance* Value::embedded() const { return object<Instance>(); }
const Array* Value::elements() const { return object<Array>(); }
const NamedValues* Value::arguments() const { return object<NamedValues>(); }
const std::vector<Value>* Value::items() const { return object<std::vector<Value>>(); }

template <typename T>
const T* Value::object() const {
  const Shared<T>* content = shared<T>();
  return content ? &**content : nullptr;
}

std::optional<Value> Value::asInteger(CMPIType type) const {
  std::optional<Value> result;
  if (const CMPIValue* content = scalar()) {
    visitInteger(type_, *content, [&](auto number) {
      CMPIValue other = {};
      visitInteger(type, other, [&](auto& target) {
        using Target = std::remove_reference_t<decltype(target)>;
        if (std::in_range<Target>(number)) {
          target = static_cast<Target>(number);  // NOLINT(bugprone-signed-char-misuse): a small number, no letter
          result = Value(type, other);
        }
      });
    });
  }
  return result;
}

std::optional<Value> Value::as(CMPIType type) const {
  if (isNull()) {
    return null(type);
  }
  return type_ == type ? *this : asInteger(type);
}

std::string Value::toString() const {
  if (isNull()) {
    return "NULL";
  }
  if (const auto* string = text()) {
    return inQuotes(*string);
  }
  if (const ObjectPath* reference = path()) {
    return inQuotes(shortened(reference->toString()));
  }
  if (const Instance* instance = embedded()) {
    return inQuotes(shortened(instance->path()->toString()));
  }
  if (const DateTime* dateTime = time()) {
    return inQuotes(dateTime->format());
  }
  if (const Array* array = elements()) {
    std::string list = "{";
    for (const Value& element : array->elements) {
      list += (list.size() > 1 ? "," : "") + element.toString();
    }
    return list + "}";
  }
  switch (type_) {
    case CMPI_boolean:
      return isTrue() ? "TRUE" : "FALSE";
    case CMPI_char16:
      return std::to_string(scalar()->char16);
    case CMPI_ptr:
    case CMPI_args:
    case CMPI_enumeration:
      return "(" + describeType(type_) + ")";
    default:
      return numberText(type_, *scalar());
  }
}

const Value* NamedValues::find(std::string_view name) const {
  for (std::size_t index = 0; index < values_.size(); ++index) {
    if (sameName(names()[index], name)) {
      return &values_[index];
    }
  }
  return nullptr;
}

void NamedValues::set(std::string_view name, Value value) {
  if (const Value* present = find(name)) {
    values_[static_cast<std::size_t>(present - values_.data())] = std::move(value);
    return;
  }
  constexpr std::size_t usual = 4;  // most paths have no more keys
  if (values_.empty()) {
    own_.reserve(usual);
    values_.reserve(usual);
  } else if (shared_) {
    own_ = **shared_;
  }
  shared_.reset();
  own_.resize(values_.size());  // there is one more if memory ran out for its value
  own_.emplace_back(name);
  values_.push_back(std::move(value));
}

}  // namespace Cimom
