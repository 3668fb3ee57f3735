// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpidt.h>

#include <stdexcept>
#include <string>

namespace Cimom {

// What the object manager was given to work with (schema, registration, providers) is wrong. The text names the file,
// the line if there is one, and what is wrong.
class ConfigurationError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// An operation that ends with a CMPI return code other than OK. The binary interface turns it into a CMPIStatus.
class StatusError : public std::runtime_error {
 public:
  StatusError(CMPIrc code, const std::string& message) : std::runtime_error(message), code_(code) {}

  CMPIrc code() const { return code_; }

 private:
  CMPIrc code_;
};

}  // namespace Cimom
