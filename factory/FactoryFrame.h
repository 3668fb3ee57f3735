// SPDX-License-Identifier: Apache-2.0
// The trace frame of the factory's members.
#pragma once

#include <string>

#include "trace/Trace.h"

namespace QV::IPConfigComposite {

extern const std::string loggerIPObjectFactory;

// The members report under one unit name, wherever their source stands.
inline Frame factoryFrame(const char* function) {
  return Frame(loggerIPObjectFactory, "IPConfigObjectFactory", function);
}

}  // namespace QV::IPConfigComposite
