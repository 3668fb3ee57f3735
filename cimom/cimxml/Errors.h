// SPDX-License-Identifier: Apache-2.0
// The two kinds of failure of a CIM-XML request.
#pragma once

#include <cmpimacs.h>

#include <array>
#include <stdexcept>
#include <string>

namespace Cimom::CimXml {

// The message is refused as a whole: an HTTP status and, in the CIMError header, one of the words of DSP0200 for it.
class TransportError : public std::runtime_error {
 public:
  TransportError(unsigned httpStatus, std::string cimError, const std::string& what)
      : std::runtime_error(what), httpStatus_(httpStatus), cimError_(std::move(cimError)) {}

  unsigned httpStatus() const { return httpStatus_; }
  const std::string& cimError() const { return cimError_; }

 private:
  unsigned httpStatus_;
  std::string cimError_;
};

// The operation fails: the code is the CIM status code of DSP0200, which CMPI's return codes below 50 are too.
class OperationError : public std::runtime_error {
 public:
  OperationError(int code, const std::string& description) : std::runtime_error(description), code_(code) {}

  int code() const { return code_; }

 private:
  int code_;
};

// CIM status codes of DSP0200 for pulled enumerations, which CMPI has no names for.
constexpr int cimInvalidEnumerationContext = 21;
constexpr int cimInvalidOperationTimeout = 22;
constexpr int cimFilteredEnumerationNotSupported = 25;
constexpr int cimContinuationOnErrorNotSupported = 26;
constexpr int cimServerLimitsExceeded = 27;

// What a CIM status code means, for an error that comes without a text.
inline const char* meaningOf(int code) {
  static constexpr std::array<const char*, 18> meanings = {
      "no error",
      "the operation failed for a reason that is not known",
      "access is denied",
      "the namespace does not exist",
      "a parameter is not valid",
      "the class does not exist",
      "the object does not exist",
      "the operation is not supported",
      "the class has subclasses",
      "the class has instances",
      "the superclass does not exist",
      "the object exists already",
      "the property does not exist",
      "the value is not of the declared type",
      "the query language is not supported",
      "the query is not valid",
      "the method is not available",
      "the method does not exist",
  };
  const auto index = static_cast<std::size_t>(code);
  return meanings[index < meanings.size() ? index : static_cast<std::size_t>(CMPI_RC_ERR_FAILED)];
}

// Turns a CMPI status that is not OK into an OperationError. Return codes that are CMPI's own and no CIM status
// (CMPI_RC_ERROR_SYSTEM and the like) become CIM_ERR_FAILED.
inline void requireOk(const CMPIStatus& status) {
  if (status.rc == CMPI_RC_OK) {
    return;
  }
  const char* text = status.msg ? CMGetCharsPtr(status.msg, nullptr) : nullptr;
  const bool isCimStatus = status.rc <= CMPI_RC_ERR_METHOD_NOT_FOUND;
  const int code = isCimStatus ? static_cast<int>(status.rc) : static_cast<int>(CMPI_RC_ERR_FAILED);
  if (text && *text) {
    throw OperationError(code, text);
  }
  throw OperationError(
      code, isCimStatus ? meaningOf(code) : "the operation failed with return code " + std::to_string(status.rc));
}

// The same, and the object must be there.
inline void requireOk(const CMPIStatus& status, const void* object) {
  requireOk(status);
  if (!object) {
    throw OperationError(CMPI_RC_ERR_FAILED, "the operation succeeded but returned nothing");
  }
}

}  // namespace Cimom::CimXml
