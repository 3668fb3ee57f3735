#ifndef CIMOM_BROKER_ARRAY_H_
#define CIMOM_BROKER_ARRAY_H_

#include <vector>

#include "cimom/model/Value.h"

namespace Cimom {

/// A CIM array: elements of one type, each of which may be null.
struct Array {
  CMPIType elementType = CMPI_null;
  std::vector<Value> elements;
};

}  // namespace Cimom

#endif  // CIMOM_BROKER_ARRAY_H_
