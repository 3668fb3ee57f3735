#include "cimom/broker/MessageText.h"

#include <vector>

#include "cimom/broker/Handle.h"

namespace Cimom {
namespace {

/// The next argument; what is narrower than an int travels as one.
std::string argumentText(std::va_list* arguments) {
  // NOLINTNEXTLINE(clang-analyzer-valist.Uninitialized): the caller has started the list.
  const int type = va_arg(*arguments, int);
  switch (type) {
    case CMPI_boolean:
      return va_arg(*arguments, int) ? "true" : "false";
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
      return std::to_string(va_arg(*arguments, int));
    case CMPI_uint32:
      return std::to_string(va_arg(*arguments, unsigned));
    case CMPI_uint64:
      return std::to_string(va_arg(*arguments, CMPIUint64));
    case CMPI_sint64:
      return std::to_string(va_arg(*arguments, CMPISint64));
    case CMPI_real32:
    case CMPI_real64:
      return std::to_string(va_arg(*arguments, double));
    case CMPI_chars: {
      const char* text = va_arg(*arguments, const char*);
      return text ? text : "";
    }
    case CMPI_string:
      return textOf(va_arg(*arguments, const CMPIString*));
    default:
      throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE, "no message argument has the CMPI type " + std::to_string(type));
  }
}

}  // namespace

std::string messageText(const std::string& message, CMPICount count, std::va_list arguments) {
  std::va_list rest;
  va_copy(rest, arguments);
  std::vector<std::string> texts;
  try {
    while (texts.size() < count) texts.push_back(argumentText(&rest));
  } catch (...) {
    va_end(rest);
    throw;
  }
  va_end(rest);
  std::string result;
  for (std::size_t position = 0; position < message.size(); ++position) {
    const unsigned digit = position + 1 < message.size() ? static_cast<unsigned>(message[position + 1] - '0') : 10;
    if (message[position] == '$' && digit < texts.size() && digit < 10) {
      result += texts[digit];
      ++position;
    } else {
      result += message[position];
    }
  }
  return result;
}

}  // namespace Cimom
