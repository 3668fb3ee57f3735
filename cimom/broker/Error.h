#ifndef CIMOM_BROKER_ERROR_H_
#define CIMOM_BROKER_ERROR_H_

#include <cmpidt.h>

#include <optional>
#include <string>

#include "cimom/broker/Array.h"

namespace Cimom {

/// A CIM_Error that a provider fills in; texts that nobody set are absent.
struct Error {
  std::optional<std::string> owningEntity;
  std::optional<std::string> messageId;
  std::optional<std::string> message;
  CMPIErrorSeverity severity = CMPIErrorSeverityUnknown;
  CMPIErrorProbableCause probableCause = CMPIErrorProbableCauseUnknown;
  CMPIrc statusCode = CMPI_RC_OK;
  std::optional<std::string> statusCodeDescription;
  CMPIErrorType type = CMPIErrorTypeUnknown;
  std::optional<std::string> otherType;
  std::optional<std::string> probableCauseDescription;
  std::optional<std::string> source;
  CMPIErrorSrcFormat sourceFormat = CMPIErrorSrcFormatUnknown;
  std::optional<std::string> otherSourceFormat;
  std::optional<Array> recommendedActions;
  std::optional<Array> messageArguments;
};

}  // namespace Cimom

#endif  // CIMOM_BROKER_ERROR_H_
