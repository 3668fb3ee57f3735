#ifndef CIMOM_BROKER_OBJECTPATH_H_
#define CIMOM_BROKER_OBJECTPATH_H_

#include <string>

#include "cimom/broker/NamedValues.h"

namespace Cimom {

/// An object path: where an instance (or, without keys, a class) is. Host and namespace may be empty.
struct ObjectPath {
  std::string host;
  std::string nameSpace;
  std::string className;
  NamedValues keys;

  /// The path as an untyped WBEM URI (DSP0207): "//host/namespace:Class.Key=\"value\",…", the host where there is one.
  std::string toString() const;
};

}  // namespace Cimom

#endif  // CIMOM_BROKER_OBJECTPATH_H_
