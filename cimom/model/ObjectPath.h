// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "cimom/model/Value.h"

namespace Cimom {

// An object path: where an instance (or, without keys, a class) is. Host and namespace may be empty.
struct ObjectPath {
  std::string host;
  std::string nameSpace;
  std::string className;
  NamedValues keys;

  // The path as an untyped WBEM URI (DSP0207): "//host/namespace:Class.Key=\"value\",…", the host if there is one.
  std::string toString() const {
    std::string text;
    if (!host.empty()) {
      text += "//" + host + "/";
    }
    if (!nameSpace.empty()) {
      text += nameSpace + ":";
    }
    text += className;
    char separator = '.';
    for (const auto& [name, value] : keys) {
      text.append(1, separator).append(name).append("=").append(value.toString());
      separator = ',';
    }
    return text;
  }
};

}  // namespace Cimom
