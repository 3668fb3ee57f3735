// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/CmpiValue.h"

#include <cstring>

#include "cimom/broker/Handle.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

// Every member of CMPIValue starts at its first byte, but callers pass the address of a variable that is as long as
// its own type only: no more than that may be read.
template <typename T>
T member(const CMPIValue* value) {
  T read;
  std::memcpy(&read, value, sizeof read);  // NOLINT(bugprone-sizeof-expression): pointers are values here
  return read;
}

CMPIType storedType(CMPIType elementType) {
  return elementType == CMPI_chars || elementType == CMPI_charsptr ? CMPI_string : elementType;
}

Value arrayFromCmpi(const CMPIArray* array, CMPIType stored) {
  if (!array) {
    return Value::null(stored);
  }
  const Shared<Array>& source = heldBy<Array>(array);
  if (source->elementType != elementTypeOf(stored)) {
    throw StatusError(CMPI_RC_ERR_TYPE_MISMATCH,
                      "expected " + describeType(stored) + ", not " + describeType(arrayOf(source->elementType)));
  }
  return Value::array(source);
}

}  // namespace

Value fromCmpi(const CMPIValue* value, CMPIType type) {
  const CMPIType elementType = elementTypeOf(type);
  const CimType* row = findType(type);
  if (type != CMPI_null && !row) {
    throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE, "CMPI type " + std::to_string(type) + " is not a CIM data type");
  }
  const CMPIType stored = isArray(type) ? arrayOf(storedType(elementType)) : storedType(elementType);
  if (!value || type == CMPI_null) {
    return Value::null(stored);
  }
  if (isArray(type)) {
    return arrayFromCmpi(member<const CMPIArray*>(value), stored);
  }
  if (row->size > 0) {
    CMPIValue content = {};
    std::memcpy(&content, value, row->size);
    return Value::scalar(type, content);
  }
  if (type == CMPI_chars) {
    return Value::string(reinterpret_cast<const char*>(value));
  }
  if (type == CMPI_charsptr) {
    const auto characters = member<CMPIValuePtr>(value);
    if (!characters.ptr) {
      return Value::null(stored);
    }
    return Value::string(std::string(static_cast<const char*>(characters.ptr), characters.length));
  }
  if (!member<const void*>(value)) {
    return Value::null(stored);
  }
  switch (type) {
    case CMPI_string:
      return Value::string(textOf(member<const CMPIString*>(value)));
    case CMPI_ref:
      return Value::reference(heldBy<ObjectPath>(member<const CMPIObjectPath*>(value)));
    case CMPI_instance:
      return Value::instance(heldBy<Instance>(member<const CMPIInstance*>(value)));
    case CMPI_args:
      return Value::arguments(modelOf<Args>(member<const CMPIArgs*>(value)).arguments);
    case CMPI_enumeration:
      return Value::enumeration(modelOf<Enumeration>(member<const CMPIEnumeration*>(value)).items);
    default:
      return Value::dateTime(modelOf<DateTime>(member<const CMPIDateTime*>(value)));
  }
}

CMPIData toCmpi(const Value& value, CMPIValueState state) {
  CMPIData data = {value.type(), state, {}};
  if (const CMPIValue* scalar = value.scalar()) {
    data.value = *scalar;
  } else if (const auto* text = value.shared<std::string>()) {
    data.value.string = make(Text{*text});
  } else if (const DateTime* time = value.time()) {
    data.value.dateTime = make(*time);
  } else if (const auto* reference = value.shared<ObjectPath>()) {
    data.value.ref = make(*reference);
  } else if (const auto* instance = value.shared<Instance>()) {
    data.value.inst = make(*instance);
  } else if (const auto* array = value.shared<Array>()) {
    data.value.array = make(*array);
  } else if (const NamedValues* arguments = value.arguments()) {
    data.value.args = make(Args{*arguments});
  } else if (const std::vector<Value>* items = value.items()) {
    data.value.Enum = make(Enumeration{*items, 0});
  } else {
    data.state = static_cast<CMPIValueState>(data.state | CMPI_nullValue);
  }
  return data;
}

}  // namespace Cimom
