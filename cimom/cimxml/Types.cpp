#include "cimom/cimxml/Types.h"

#include <cmpimacs.h>
#include <strings.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <limits>

#include "cimom/cimxml/Utf8.h"

namespace Cimom::CimXml {
namespace {

struct TypeName {
  CMPIType type;
  const char* name;
};

constexpr std::array<TypeName, 16> typeNames = {{{CMPI_boolean, "boolean"},
                                                 {CMPI_char16, "char16"},
                                                 {CMPI_real32, "real32"},
                                                 {CMPI_real64, "real64"},
                                                 {CMPI_uint8, "uint8"},
                                                 {CMPI_uint16, "uint16"},
                                                 {CMPI_uint32, "uint32"},
                                                 {CMPI_uint64, "uint64"},
                                                 {CMPI_sint8, "sint8"},
                                                 {CMPI_sint16, "sint16"},
                                                 {CMPI_sint32, "sint32"},
                                                 {CMPI_sint64, "sint64"},
                                                 {CMPI_ref, "reference"},
                                                 {CMPI_string, "string"},
                                                 {CMPI_dateTime, "datetime"},
                                                 // An embedded instance travels as its text.
                                                 {CMPI_instance, "string"}}};

// The member of CMPIValue that holds a numeric type, handed to the visitor; false for any other type.
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

template <typename Number>
bool parseWith(std::string_view text, Number& number, auto... format) {
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number, format...);
  return error == std::errc() && end == text.data() + text.size();
}

template <typename Number>
bool parseNumber(std::string_view text, Number& number) {
  if (text.size() > 1 && text[0] == '+' && text[1] != '-') text.remove_prefix(1);
  if constexpr (std::is_integral_v<Number>) {
    const bool isHexadecimal =
        text.size() > 2 && text[0] == '0' && (text[1] == 'x' || text[1] == 'X') && text[2] != '-';
    if (isHexadecimal) return parseWith(text.substr(2), number, 16);
  }
  return parseWith(text, number);
}

bool equalsIgnoringCase(std::string_view text, std::string_view word) {
  return text.size() == word.size() && strncasecmp(text.data(), word.data(), word.size()) == 0;
}

std::string formatString(const CMPIString* string) {
  const char* chars = string ? CMGetCharsPtr(string, nullptr) : nullptr;
  return chars ? chars : "";
}

std::string formatDateTime(const CMPIDateTime* dateTime) {
  return dateTime ? formatString(CMGetStringFormat(dateTime, nullptr)) : "";
}

}  // namespace

const char* typeName(CMPIType type) {
  const CMPIType elementType = type & static_cast<CMPIType>(~CMPI_ARRAY);
  const CMPIType known = elementType == CMPI_chars ? CMPI_string : elementType;
  const auto* const row =
      std::find_if(typeNames.begin(), typeNames.end(), [known](const TypeName& name) { return name.type == known; });
  return row == typeNames.end() ? nullptr : row->name;
}

std::optional<CMPIType> typeOf(std::string_view name) {
  const auto* const row = std::find_if(typeNames.begin(), typeNames.end(),
                                       [name](const TypeName& candidate) { return candidate.name == name; });
  if (row == typeNames.end()) return std::nullopt;
  return row->type;
}

const char* keyValueType(CMPIType type) {
  if (type == CMPI_boolean) return "boolean";
  CMPIValue unused{};
  return visitNumber(type, unused, [](auto&) {}) ? "numeric" : "string";
}

std::optional<CMPIValue> parseScalar(CMPIType type, std::string_view text) {
  CMPIValue value{};
  bool parsed = false;
  if (visitNumber(type, value, [&](auto& number) { parsed = parseNumber(text, number); })) {
    // The visitor has told.
  } else if (type == CMPI_boolean) {
    value.boolean = equalsIgnoringCase(text, "true");
    parsed = value.boolean || equalsIgnoringCase(text, "false");
  } else if (type == CMPI_char16) {
    const auto character = decodeOne(text);
    parsed = character && *character <= std::numeric_limits<CMPIChar16>::max();
    if (parsed) value.char16 = static_cast<CMPIChar16>(*character);
  }
  if (!parsed) return std::nullopt;
  return value;
}

std::string formatScalar(CMPIType type, const CMPIValue& value) {
  std::array<char, 32> buffer{};
  char* end = buffer.data();
  const auto write = [&](auto number) { end = std::to_chars(end, buffer.data() + buffer.size(), number).ptr; };
  if (visitNumber(type, value, write)) return {buffer.data(), end};
  switch (type) {
    case CMPI_boolean:
      return value.boolean ? "TRUE" : "FALSE";
    case CMPI_char16:
      return encode(value.char16);
    case CMPI_string:
      return formatString(value.string);
    case CMPI_chars:
      return value.chars ? value.chars : "";
    case CMPI_dateTime:
      return formatDateTime(value.dateTime);
    default:
      return "";
  }
}

}  // namespace Cimom::CimXml
