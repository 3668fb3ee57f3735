// SPDX-License-Identifier: Apache-2.0
#include "bmcip/client/Failure.h"

namespace Bmcip {

const char* wordOf(FailureKind kind) {
  static constexpr const char* words[] = {"unreachable", "timed-out", "certificate", "login",
                                          "not-served",  "error",     "malformed"};
  return words[static_cast<int>(kind) - static_cast<int>(FailureKind::Unreachable)];
}

}  // namespace Bmcip
