// SPDX-License-Identifier: Apache-2.0
#include "cimom/model/Types.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <iterator>

#include "cimom/model/Names.h"

namespace Cimom {
namespace {

// A type that every notation calls by one name.
constexpr CimType common(CMPIType code, const char* name, std::size_t size) { return {code, name, name, name, size}; }

constexpr CimType types[] = {
    common(CMPI_boolean, "boolean", sizeof(CMPIBoolean)),
    common(CMPI_char16, "char16", sizeof(CMPIChar16)),
    common(CMPI_real32, "real32", sizeof(CMPIReal32)),
    common(CMPI_real64, "real64", sizeof(CMPIReal64)),
    common(CMPI_uint8, "uint8", sizeof(CMPIUint8)),
    common(CMPI_uint16, "uint16", sizeof(CMPIUint16)),
    common(CMPI_uint32, "uint32", sizeof(CMPIUint32)),
    common(CMPI_uint64, "uint64", sizeof(CMPIUint64)),
    common(CMPI_sint8, "sint8", sizeof(CMPISint8)),
    common(CMPI_sint16, "sint16", sizeof(CMPISint16)),
    common(CMPI_sint32, "sint32", sizeof(CMPISint32)),
    common(CMPI_sint64, "sint64", sizeof(CMPISint64)),
    common(CMPI_string, "string", 0),
    common(CMPI_dateTime, "datetime", 0),
    // MOF writes the class in the place of a type, and REF after it.
    {CMPI_ref, "reference", nullptr, "reference", 0},
    // An embedded instance travels as the text of its XML.
    {CMPI_instance, "instance", nullptr, "string", 0},
    // Two ways in which providers pass a string.
    {CMPI_chars, "string", nullptr, "string", 0},
    {CMPI_charsptr, "string", nullptr, nullptr, 0},
    // What is a value in the interface only.
    {CMPI_args, "arguments", nullptr, nullptr, 0},
    {CMPI_enumeration, "enumeration", nullptr, nullptr, 0},
    {CMPI_ptr, "pointer", nullptr, nullptr, sizeof(CMPIValuePtr)},
};

// Where the number of a type's row stands: its code has bits in one of its two bytes.
constexpr std::size_t placeOf(CMPIType code) { return (code & 0xFFU) + (code >> 8U); }

// At the place of a type's code the number of its row, from 1.
constexpr auto rowNumbers = [] {
  std::array<std::uint8_t, 0x200> numbers{};
  for (std::size_t row = 0; row < std::size(types); ++row) {
    numbers[placeOf(types[row].code)] = static_cast<std::uint8_t>(row + 1);
  }
  return numbers;
}();

constexpr const CimType* rowOf(CMPIType code) {
  const std::uint8_t number = rowNumbers[placeOf(code)];
  return number > 0 && types[number - 1].code == code ? &types[number - 1] : nullptr;
}

static_assert(std::ranges::all_of(types, [](const CimType& type) { return rowOf(type.code) == &type; }),
              "two types share a place");

// The first type for which the test holds, or CMPI_null.
template <typename Test>
CMPIType firstType(Test test) {
  const auto* const found = std::ranges::find_if(types, test);
  return found == std::end(types) ? CMPIType(CMPI_null) : found->code;
}

}  // namespace

const CimType* findType(CMPIType code) { return rowOf(elementTypeOf(code)); }

CMPIType typeOfMofName(std::string_view name) {
  return firstType([name](const CimType& type) { return type.mofName && sameName(type.mofName, name); });
}

CMPIType typeOfXmlName(std::string_view name) {
  return firstType([name](const CimType& type) { return type.xmlName && type.xmlName == name; });
}

std::string describeType(CMPIType type) {
  const CimType* row = findType(type);
  return std::string(row ? row->name : "value of no type") + (isArray(type) ? "[]" : "");
}

const char* xmlTypeName(CMPIType type) {
  const CimType* row = findType(type);
  return row ? row->xmlName : nullptr;
}

std::string numberText(CMPIType type, const CMPIValue& value) {
  std::array<char, 32> buffer{};
  char* end = buffer.data();
  visitNumber(type, value, [&](auto number) { end = std::to_chars(end, end + buffer.size(), number).ptr; });
  return {buffer.data(), end};
}

}  // namespace Cimom
