// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/ScalarText.h"

#include <charconv>
#include <limits>
#include <type_traits>

#include "cimom/cimxml/Utf8.h"
#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom::CimXml {
namespace {

template <typename Number>
bool parseWith(std::string_view text, Number& number, auto... format) {
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number, format...);
  return error == std::errc() && end == text.data() + text.size();
}

template <typename Number>
bool parseNumber(std::string_view text, Number& number) {
  if (text.size() > 1 && text[0] == '+' && text[1] != '-') {
    text.remove_prefix(1);
  }
  if constexpr (std::is_integral_v<Number>) {
    const bool isHexadecimal =
        text.size() > 2 && text[0] == '0' && (text[1] == 'x' || text[1] == 'X') && text[2] != '-';
    if (isHexadecimal) {
      return parseWith(text.substr(2), number, 16);
    }
  }
  return parseWith(text, number);
}

}  // namespace

const char* keyValueType(CMPIType type) {
  if (type == CMPI_boolean) {
    return "boolean";
  }
  return isNumber(type) ? "numeric" : "string";
}

std::optional<CMPIValue> parseScalar(CMPIType type, std::string_view text) {
  CMPIValue value{};
  bool parsed = false;
  if (visitNumber(type, value, [&](auto& number) { parsed = parseNumber(text, number); })) {
    // The visitor has set it.
  } else if (type == CMPI_boolean) {
    value.boolean = sameName(text, "true");
    parsed = value.boolean || sameName(text, "false");
  } else if (type == CMPI_char16) {
    const auto character = decodeOne(text);
    parsed = character && *character <= std::numeric_limits<CMPIChar16>::max();
    if (parsed) {
      value.char16 = static_cast<CMPIChar16>(*character);
    }
  }
  if (!parsed) {
    return std::nullopt;
  }
  return value;
}

std::string formatScalar(const Cimom::Value& value) {
  if (const DateTime* time = value.time()) {
    return time->format();
  }
  const CMPIValue* scalar = value.scalar();
  switch (scalar ? value.type() : CMPIType(CMPI_null)) {
    case CMPI_boolean:
      return scalar->boolean ? "TRUE" : "FALSE";
    case CMPI_char16:
      return encode(scalar->char16);
    case CMPI_null:
      return "";
    default:
      return numberText(value.type(), *scalar);
  }
}

}  // namespace Cimom::CimXml
