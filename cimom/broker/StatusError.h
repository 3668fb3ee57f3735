#ifndef CIMOM_BROKER_STATUSERROR_H_
#define CIMOM_BROKER_STATUSERROR_H_

#include <cmpidt.h>

#include <stdexcept>
#include <string>

namespace Cimom {

/// An operation that ends with a CMPI return code other than OK. The binary interface turns it into a CMPIStatus.
class StatusError : public std::runtime_error {
 public:
  StatusError(CMPIrc code, const std::string& message) : std::runtime_error(message), code_(code) {}

  CMPIrc code() const { return code_; }

 private:
  CMPIrc code_;
};

}  // namespace Cimom

#endif  // CIMOM_BROKER_STATUSERROR_H_
