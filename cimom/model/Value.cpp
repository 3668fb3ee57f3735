#include "cimom/model/Value.h"

#include <charconv>
#include <cstring>
#include <limits>

#include "cimom/broker/Array.h"
#include "cimom/broker/Handle.h"
#include "cimom/broker/StatusError.h"
#include "cimom/model/Instance.h"
#include "cimom/model/ObjectPath.h"

namespace Cimom {
namespace {

struct TypeRow {
  CMPIType type;
  const char* name;
  std::size_t size;  ///< of a scalar, else 0
};

constexpr TypeRow kTypes[] = {
    {CMPI_boolean, "boolean", sizeof(CMPIBoolean)},
    {CMPI_char16, "char16", sizeof(CMPIChar16)},
    {CMPI_real32, "real32", sizeof(CMPIReal32)},
    {CMPI_real64, "real64", sizeof(CMPIReal64)},
    {CMPI_uint8, "uint8", sizeof(CMPIUint8)},
    {CMPI_uint16, "uint16", sizeof(CMPIUint16)},
    {CMPI_uint32, "uint32", sizeof(CMPIUint32)},
    {CMPI_uint64, "uint64", sizeof(CMPIUint64)},
    {CMPI_sint8, "sint8", sizeof(CMPISint8)},
    {CMPI_sint16, "sint16", sizeof(CMPISint16)},
    {CMPI_sint32, "sint32", sizeof(CMPISint32)},
    {CMPI_sint64, "sint64", sizeof(CMPISint64)},
    {CMPI_string, "string", 0},
    {CMPI_chars, "string", 0},
    {CMPI_charsptr, "string", 0},
    {CMPI_dateTime, "datetime", 0},
    {CMPI_ref, "reference", 0},
    {CMPI_instance, "instance", 0},
    {CMPI_ptr, "pointer", sizeof(CMPIValuePtr)},
};

const TypeRow* rowOf(CMPIType type) {
  for (const TypeRow& row : kTypes) {
    if (row.type == type) return &row;
  }
  return nullptr;
}

/// Every member of CMPIValue starts at its first byte, but callers pass the address of a variable that is as long as
/// its own type only: no more than that may be read.
template <class T>
T member(const CMPIValue* value) {
  T read;
  std::memcpy(&read, value, sizeof read);  // NOLINT(bugprone-sizeof-expression): pointers are values here
  return read;
}

template <class T>
CMPIValue scalarOf(T value) {
  CMPIValue content = {};
  std::memcpy(&content, &value, sizeof value);
  return content;
}

CMPIType storedType(CMPIType elementType) {
  return elementType == CMPI_chars || elementType == CMPI_charsptr ? CMPI_string : elementType;
}

/// An integer of any type: the magnitude and the sign, so that all of both 64-bit ranges fit.
struct Number {
  bool negative;
  CMPIUint64 magnitude;
};

template <class T>
Number numberOf(const CMPIValue& value) {
  const T number = member<T>(&value);
  if constexpr (std::is_signed_v<T>) {
    if (number < 0) return {true, CMPIUint64(0) - static_cast<CMPIUint64>(number)};
  }
  return {false, static_cast<CMPIUint64>(number)};
}

template <class T>
std::optional<CMPIValue> fitted(Number number) {
  constexpr auto most = static_cast<CMPIUint64>(std::numeric_limits<T>::max());
  if (!number.negative) {
    if (number.magnitude > most) return std::nullopt;
    return scalarOf(static_cast<T>(number.magnitude));
  }
  if (std::is_unsigned_v<T> || number.magnitude > most + 1) return std::nullopt;
  return scalarOf(static_cast<T>(CMPIUint64(0) - number.magnitude));
}

/// Calls `operation` with a value of the C type of an integer type.
template <class Operation>
auto withIntegerType(CMPIType type, Operation operation) {
  switch (type) {
    case CMPI_uint8:
      return operation(CMPIUint8());
    case CMPI_uint16:
      return operation(CMPIUint16());
    case CMPI_uint32:
      return operation(CMPIUint32());
    case CMPI_sint8:
      return operation(CMPISint8());
    case CMPI_sint16:
      return operation(CMPISint16());
    case CMPI_sint32:
      return operation(CMPISint32());
    case CMPI_sint64:
      return operation(CMPISint64());
    default:
      return operation(CMPIUint64());
  }
}

Number numberOf(CMPIType type, const CMPIValue& value) {
  return withIntegerType(type, [&](auto zero) { return numberOf<decltype(zero)>(value); });
}

std::string quoted(std::string_view text) {
  std::string result = "\"";
  for (const char letter : text) {
    if (letter == '"' || letter == '\\') result += '\\';
    result += letter;
  }
  return result + '"';
}

std::string realText(double value) {
  char text[32];
  const auto [end, error] = std::to_chars(text, text + sizeof text, value);
  return std::string(text, end);
}

}  // namespace

std::size_t scalarSize(CMPIType type) {
  const TypeRow* row = rowOf(type);
  return row ? row->size : 0;
}

bool isInteger(CMPIType type) { return type >= CMPI_uint8 && type <= CMPI_sint64; }

std::string typeName(CMPIType type) {
  const TypeRow* row = rowOf(static_cast<CMPIType>(type & ~CMPI_ARRAY));
  return std::string(row ? row->name : "value of no type") + (type & CMPI_ARRAY ? "[]" : "");
}

Value Value::null(CMPIType type) { return Value(type, {}); }
Value Value::boolean(bool value) { return Value(CMPI_boolean, scalarOf<CMPIBoolean>(value)); }
Value Value::uint32(CMPIUint32 value) { return Value(CMPI_uint32, scalarOf(value)); }
Value Value::uint64(CMPIUint64 value) { return Value(CMPI_uint64, scalarOf(value)); }
Value Value::sint64(CMPISint64 value) { return Value(CMPI_sint64, scalarOf(value)); }
Value Value::real64(CMPIReal64 value) { return Value(CMPI_real64, scalarOf(value)); }
Value Value::char16(CMPIChar16 value) { return Value(CMPI_char16, scalarOf(value)); }
Value Value::string(std::string value) { return Value(CMPI_string, std::move(value)); }
Value Value::dateTime(DateTime value) { return Value(CMPI_dateTime, value); }
Value Value::reference(ObjectPath value) {
  return Value(CMPI_ref, std::make_shared<const ObjectPath>(std::move(value)));
}
Value Value::instance(Instance value) {
  return Value(CMPI_instance, std::make_shared<const Instance>(std::move(value)));
}
Value Value::array(Array value) {
  const auto type = static_cast<CMPIType>(value.elementType | CMPI_ARRAY);
  return Value(type, std::make_shared<const Array>(std::move(value)));
}

Value Value::fromCmpi(const CMPIValue* value, CMPIType type) {
  const auto elementType = static_cast<CMPIType>(type & ~CMPI_ARRAY);
  if (type != CMPI_null && !rowOf(elementType)) {
    throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE, "no CIM value has the CMPI type " + std::to_string(type));
  }
  const auto stored = static_cast<CMPIType>(storedType(elementType) | (type & CMPI_ARRAY));
  if (!value || type == CMPI_null) return null(stored);
  if (type & CMPI_ARRAY) {
    const auto* array = member<const CMPIArray*>(value);
    if (!array) return null(stored);
    const Array& source = modelOf<Array>(array);
    if (source.elementType != storedType(elementType)) {
      throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE,
                        "an array of " + typeName(source.elementType) + " is no " + typeName(stored));
    }
    return Value::array(source);
  }
  if (const std::size_t size = scalarSize(type)) {
    CMPIValue content = {};
    std::memcpy(&content, value, size);
    return Value(type, content);
  }
  if (type == CMPI_chars) return string(reinterpret_cast<const char*>(value));
  if (type == CMPI_charsptr) {
    const auto characters = member<CMPIValuePtr>(value);
    if (!characters.ptr) return null(stored);
    return string(std::string(static_cast<const char*>(characters.ptr), characters.length));
  }
  if (!member<const void*>(value)) return null(stored);
  switch (type) {
    case CMPI_string:
      return string(textOf(member<const CMPIString*>(value)));
    case CMPI_ref:
      return reference(modelOf<ObjectPath>(member<const CMPIObjectPath*>(value)));
    case CMPI_instance:
      return instance(modelOf<Instance>(member<const CMPIInstance*>(value)));
    default:
      return dateTime(modelOf<DateTime>(member<const CMPIDateTime*>(value)));
  }
}

CMPIData Value::toCmpi(CMPIValueState state) const {
  CMPIData data = {type_, state, {}};
  if (const auto* scalar = std::get_if<CMPIValue>(&content_)) {
    data.value = *scalar;
  } else if (const auto* text = std::get_if<std::string>(&content_)) {
    data.value.string = make(Text{*text});
  } else if (const auto* time = std::get_if<DateTime>(&content_)) {
    data.value.dateTime = make(*time);
  } else if (const ObjectPath* reference = path()) {
    data.value.ref = make(*reference);
  } else if (const Instance* instance = embedded()) {
    data.value.inst = make(*instance);
  } else if (const Array* array = elements()) {
    data.value.array = make(*array);
  } else {
    data.state = static_cast<CMPIValueState>(data.state | CMPI_nullValue);
  }
  return data;
}

const ObjectPath* Value::path() const {
  const auto* content = std::get_if<std::shared_ptr<const ObjectPath>>(&content_);
  return content ? content->get() : nullptr;
}

const Instance* Value::embedded() const {
  const auto* content = std::get_if<std::shared_ptr<const Instance>>(&content_);
  return content ? content->get() : nullptr;
}

const Array* Value::elements() const {
  const auto* content = std::get_if<std::shared_ptr<const Array>>(&content_);
  return content ? content->get() : nullptr;
}

std::optional<Value> Value::asInteger(CMPIType type) const {
  const auto* scalar = std::get_if<CMPIValue>(&content_);
  if (!scalar || !isInteger(type_) || !isInteger(type)) return std::nullopt;
  const Number number = numberOf(type_, *scalar);
  const auto content = withIntegerType(type, [&](auto zero) { return fitted<decltype(zero)>(number); });
  if (!content) return std::nullopt;
  return Value(type, *content);
}

std::optional<Value> Value::as(CMPIType type) const {
  if (isNull()) return null(type);
  return type_ == type ? *this : asInteger(type);
}

std::string Value::toString() const {
  if (isNull()) return "NULL";
  if (const auto* string = text()) return quoted(*string);
  if (const ObjectPath* reference = path()) return quoted(reference->toString());
  if (const Instance* instance = embedded()) return quoted(instance->path().toString());
  if (const auto* time = std::get_if<DateTime>(&content_)) return quoted(time->format());
  if (const Array* array = elements()) {
    std::string list = "{";
    for (const Value& element : array->elements) list += (list.size() > 1 ? "," : "") + element.toString();
    return list + "}";
  }
  const CMPIValue& scalar = std::get<CMPIValue>(content_);
  switch (type_) {
    case CMPI_boolean:
      return scalar.boolean ? "TRUE" : "FALSE";
    case CMPI_char16:
      return std::to_string(scalar.char16);
    case CMPI_real32:
      return realText(scalar.real32);
    case CMPI_real64:
      return realText(scalar.real64);
    case CMPI_ptr:
      return "(pointer)";
    default: {
      const Number number = numberOf(type_, scalar);
      return (number.negative ? "-" : "") + std::to_string(number.magnitude);
    }
  }
}

}  // namespace Cimom
