// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Fault.h"

namespace Testing {

namespace {

constexpr const char* faultNames[faultCount] = {
    "none",         "null-with-error",   "null-silently", "without-handle",  "good-with-error",
    "null-state",   "bad-state",         "not-found",     "null-pointer",    "number",
    "text",         "reference",         "instance",      "array",           "characters",
    "other-number", "fails-undone",      "fails-done",    "undone-silently", "nothing",
    "exception",    "foreign-exception",
};

}  // namespace

std::string nameOf(Fault fault) { return faultNames[static_cast<int>(fault)]; }

}  // namespace Testing
