#ifndef CIMOM_CONFIGURATIONERROR_H_
#define CIMOM_CONFIGURATIONERROR_H_

#include <stdexcept>

namespace Cimom {

/// What the object manager was given to work with (schema, registration, providers) is wrong. The text names the file,
/// the line where there is one, and what is wrong.
class ConfigurationError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

}  // namespace Cimom

#endif  // CIMOM_CONFIGURATIONERROR_H_
