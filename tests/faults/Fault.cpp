// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Fault.h"

#include <stdexcept>

namespace Testing {

namespace {

constexpr const char* names[faultCount] = {
    "none",
    "null-with-error",
    "null-silently",
    "without-handle",
    "good-with-error",
    "null-state",
    "bad-state",
    "not-found",
    "null-pointer",
    "number",
    "text",
    "reference",
    "instance",
    "array",
    "other-number",
    "fails-undone",
    "fails-done",
    "undone-silently",
    "nothing",
    "exception",
    "foreign-exception",
};

}  // namespace

std::string nameOf(Fault fault) { return names[static_cast<int>(fault)]; }

Fault faultOf(const std::string& name) {
  for (int i = 0; i < faultCount; ++i) {
    if (name == names[i]) {
      return static_cast<Fault>(i);
    }
  }
  throw std::invalid_argument("\"" + name + "\" is no kind of fault");
}

}  // namespace Testing
