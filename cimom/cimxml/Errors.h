/// The two kinds of failure of a CIM-XML request.
#ifndef CIMOM_CIMXML_ERRORS_H_
#define CIMOM_CIMXML_ERRORS_H_

#include <stdexcept>
#include <string>

namespace Cimom::CimXml {

/// The message is refused as a whole: an HTTP status and, in the CIMError header, one of the words of DSP0200 for it.
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

/// The operation fails: the code is the CIM status code of DSP0200, which CMPI's return codes below 50 are too.
class OperationError : public std::runtime_error {
 public:
  OperationError(int code, const std::string& description) : std::runtime_error(description), code_(code) {}

  int code() const { return code_; }

 private:
  int code_;
};

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_ERRORS_H_
