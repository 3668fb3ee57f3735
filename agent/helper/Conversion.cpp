#include "helper/Conversion.h"

#include <cmpimacs.h>

namespace QV {
namespace {

Integer fromSigned(std::int64_t value) { return {value < 0, static_cast<std::uint64_t>(value)}; }

}  // namespace

std::optional<Integer> integerOf(const CMPIData& data) {
  if (CMIsNullValue(data)) return std::nullopt;
  switch (data.type) {
    case CMPI_uint8:
      return Integer{false, data.value.uint8};
    case CMPI_uint16:
      return Integer{false, data.value.uint16};
    case CMPI_uint32:
      return Integer{false, data.value.uint32};
    case CMPI_uint64:
      return Integer{false, data.value.uint64};
    case CMPI_sint8:
      return fromSigned(data.value.sint8);
    case CMPI_sint16:
      return fromSigned(data.value.sint16);
    case CMPI_sint32:
      return fromSigned(data.value.sint32);
    case CMPI_sint64:
      return fromSigned(data.value.sint64);
    default:
      return std::nullopt;
  }
}

std::optional<std::string> textOf(const CMPIData& data) {
  if (CMIsNullValue(data)) return std::nullopt;
  if (data.type == CMPI_chars && data.value.chars) return data.value.chars;
  if (data.type != CMPI_string || CMIsNullObject(data.value.string)) return std::nullopt;
  const char* characters = CMGetCharsPtr(data.value.string, nullptr);
  if (!characters) return std::nullopt;
  return characters;
}

std::string charactersOf(const CMPIString* string) {
  if (CMIsNullObject(string)) return {};
  const char* characters = CMGetCharsPtr(string, nullptr);
  return characters ? characters : "";
}

}  // namespace QV
