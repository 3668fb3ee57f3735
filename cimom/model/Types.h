// SPDX-License-Identifier: Apache-2.0
// CIM's data types (DSP0004): the one table that values, MOF and CIM-XML read them from.
#pragma once

#include <cmpidt.h>

#include <cstddef>
#include <string>
#include <string_view>

namespace Cimom {

// A type that a value, or data that a provider passes, may have.
struct CimType {
  CMPIType code;
  const char* name;     // in messages: "uint16", "instance"
  const char* mofName;  // as MOF declares it; null if it has no word for it
  const char* xmlName;  // in a TYPE attribute (DSP0201); null if CIM-XML has no form for it
  std::size_t size;     // in bytes if CMPI passes the value itself, else 0
};

// The row of a type, of its elements' type if it is an array's; null if no value can have it.
const CimType* findType(CMPIType code);

// The first type that MOF calls so, without regard to case, or CMPI_null.
CMPIType typeOfMofName(std::string_view name);

// The first type that CIM-XML calls so (exactly, as in the DTD), or CMPI_null.
CMPIType typeOfXmlName(std::string_view name);

// What messages call a type: "uint16", "string[]" …
std::string describeType(CMPIType type);

// A type's TYPE attribute, of an array that of its elements; null if CIM-XML has no form for it.
const char* xmlTypeName(CMPIType type);

constexpr bool isArray(CMPIType type) { return (type & CMPI_ARRAY) != 0; }
constexpr CMPIType elementTypeOf(CMPIType type) { return static_cast<CMPIType>(type & ~CMPI_ARRAY); }
constexpr CMPIType arrayOf(CMPIType type) { return static_cast<CMPIType>(type | CMPI_ARRAY); }

constexpr bool isNumber(CMPIType type) {
  return (type >= CMPI_uint8 && type <= CMPI_sint64) || type == CMPI_real32 || type == CMPI_real64;
}

// Hands the member of a CMPIValue that holds a numeric type to the visitor; false, without a call, for any other type.
template <typename Union, typename Visitor>
bool visitNumber(CMPIType type, Union& value, Visitor&& visit) {
  switch (type) {
    case CMPI_uint8:
      visit(value.uint8);
      return true;
    case CMPI_uint16:
      visit(value.uint16);
      return true;
    case CMPI_uint32:
      visit(value.uint32);
      return true;
    case CMPI_uint64:
      visit(value.uint64);
      return true;
    case CMPI_sint8:
      visit(value.sint8);
      return true;
    case CMPI_sint16:
      visit(value.sint16);
      return true;
    case CMPI_sint32:
      visit(value.sint32);
      return true;
    case CMPI_sint64:
      visit(value.sint64);
      return true;
    case CMPI_real32:
      visit(value.real32);
      return true;
    case CMPI_real64:
      visit(value.real64);
      return true;
    default:
      return false;
  }
}

// The text of a number, the shortest that reads back as the same one; empty for a value of any other type.
std::string numberText(CMPIType type, const CMPIValue& value);

}  // namespace Cimom
