#ifndef CIMOM_BROKER_VALUE_H_
#define CIMOM_BROKER_VALUE_H_

#include <cmpidt.h>

#include <memory>
#include <optional>
#include <string>
#include <variant>

#include "cimom/model/DateTime.h"

namespace Cimom {

struct Array;
struct ObjectPath;
class Instance;

/// A typed CIM value, possibly null: what properties, keys, arguments and array elements hold. Values of object types
/// are copies: nothing that happens to the object that they were taken from changes them.
class Value {
 public:
  /// Null, of no type.
  Value() = default;

  static Value null(CMPIType type);
  static Value boolean(bool value);
  static Value uint32(CMPIUint32 value);
  static Value uint64(CMPIUint64 value);
  static Value sint64(CMPISint64 value);
  static Value real64(CMPIReal64 value);
  static Value char16(CMPIChar16 value);
  static Value string(std::string value);
  static Value dateTime(DateTime value);
  static Value reference(ObjectPath value);
  static Value instance(Instance value);
  static Value array(Array value);

  /// Takes what a provider passes: `value` as CMPI lays it down for `type` (for CMPI_chars the pointer is the C string
  /// itself). A null pointer, or a null object in it, is a null value. Characters become a CMPI_string.
  /// @throws StatusError CMPI_RC_ERR_INVALID_DATA_TYPE for a type that no CIM value has
  static Value fromCmpi(const CMPIValue* value, CMPIType type);

  /// The value as CMPI data; objects in it are made in the current request scope.
  CMPIData toCmpi(CMPIValueState state = CMPI_goodValue) const;

  CMPIType type() const { return type_; }
  bool isNull() const { return std::holds_alternative<std::monostate>(content_); }

  /// The text of a CMPI_string; null where the value is anything else.
  const std::string* text() const { return std::get_if<std::string>(&content_); }
  /// The path of a reference; null where the value is anything else.
  const ObjectPath* path() const;
  /// The embedded instance, or the instance of a result; null where the value is anything else.
  const Instance* embedded() const;
  /// The array; null where the value is anything else.
  const Array* elements() const;

  /// The same number as another integer type; none where it is no integer or does not fit.
  std::optional<Value> asInteger(CMPIType type) const;
  /// The same value as `type`: itself where it has that type, a null of it, or the same number; none otherwise.
  std::optional<Value> as(CMPIType type) const;

  /// The value as a key of an untyped WBEM URI (DSP0207) writes it: numbers and TRUE/FALSE bare, all else in quotes.
  std::string toString() const;

 private:
  using Content = std::variant<std::monostate, CMPIValue, std::string, DateTime, std::shared_ptr<const ObjectPath>,
                               std::shared_ptr<const Instance>, std::shared_ptr<const Array>>;

  Value(CMPIType type, Content content) : type_(type), content_(std::move(content)) {}

  CMPIType type_ = CMPI_null;
  Content content_;
};

/// The size in bytes of a scalar that CMPI passes by value; 0 for every other type.
std::size_t scalarSize(CMPIType type);

/// Whether a type is one of the eight integer types.
bool isInteger(CMPIType type);

/// The type's CIM name ("uint16", "string[]" …), for messages.
std::string typeName(CMPIType type);

}  // namespace Cimom

#endif  // CIMOM_BROKER_VALUE_H_
