#ifndef CIMOM_BROKER_MESSAGETEXT_H_
#define CIMOM_BROKER_MESSAGETEXT_H_

#include <cmpidt.h>

#include <cstdarg>
#include <string>

namespace Cimom {

/// A message with "$0" … "$9" replaced by its arguments: `count` pairs of a CMPIType and a value of it, as the slot
/// getMessage takes them.
/// @throws StatusError CMPI_RC_ERR_INVALID_DATA_TYPE for an argument of another type than a number, boolean or text
std::string messageText(const std::string& message, CMPICount count, std::va_list arguments);

}  // namespace Cimom

#endif  // CIMOM_BROKER_MESSAGETEXT_H_
