#ifndef CIMOM_BROKER_RESULT_H_
#define CIMOM_BROKER_RESULT_H_

#include <optional>
#include <vector>

#include "cimom/broker/Error.h"
#include "cimom/model/Value.h"

namespace Cimom {

/// What a provider delivers to one operation.
struct Result {
  CMPIType kind = CMPI_null;  ///< CMPI_instance or CMPI_ref where the operation takes only those; CMPI_null: anything
  std::vector<Value> items;
  std::optional<Error> error;  ///< the first error that the provider returned as a CMPIError
};

}  // namespace Cimom

#endif  // CIMOM_BROKER_RESULT_H_
