// SPDX-License-Identifier: Apache-2.0
#include "agent/helper/Conversion.h"

#include <cmpimacs.h>

namespace QV {
namespace {

Integer fromSigned(std::int64_t value) { return {value < 0, static_cast<std::uint64_t>(value)}; }

}  // namespace

bool hasValue(const CMPIData& data) { return (data.state & (CMPI_nullValue | CMPI_notFound | CMPI_badValue)) == 0; }

std::optional<Integer> integerOf(const CMPIData& data) {
  if (!hasValue(data)) {
    return std::nullopt;
  }
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

const char* textOf(const CMPIData& data) {
  if (!hasValue(data)) {
    return nullptr;
  }
  if (data.type == CMPI_chars) {
    return data.value.chars;
  }
  return data.type == CMPI_string ? textOf(data.value.string) : nullptr;
}

const char* textOf(const CMPIString* string) {
  return CMIsNullObject(string) ? nullptr : CMGetCharsPtr(string, nullptr);
}

}  // namespace QV
