// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/RefusedReading.h"

#include <QV/ProviderHelper.h>
#include <strings.h>

namespace Testing {

namespace {

std::string& refusedClass() {
  static std::string name;
  return name;
}

}  // namespace

void refuseNextReading(const std::string& compositeClass) { refusedClass() = compositeClass; }

}  // namespace Testing

namespace QV {

bool textEqual(const char* a, const char* b) {
  if (!a || !b) {
    return false;
  }
  // The factory compares the class that it is asked for with its own.
  std::string& refused = Testing::refusedClass();
  if (!refused.empty() && refused == a && refused == b) {
    refused.clear();
    return false;
  }
  return ::strcasecmp(a, b) == 0;
}

}  // namespace QV
