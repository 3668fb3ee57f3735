// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdexcept>
#include <string>

namespace Bmcip {

// Why a server did not answer what it was asked. The number is the exit status of bmcip; of several servers, that of
// the greatest.
enum class FailureKind {
  Unreachable = 10,
  TimedOut = 11,
  Certificate = 12,
  Login = 13,
  NotServed = 14,  // the namespace or the class
  Error = 15,      // what else an object manager refuses
  Malformed = 16,  // no reply that CIM-XML knows
};

// The kind in one word: "unreachable".
const char* wordOf(FailureKind kind);

// The text says what is wrong and what to do about it; it does not name the server.
class Failure : public std::runtime_error {
 public:
  Failure(FailureKind kind, const std::string& what) : std::runtime_error(what), kind_(kind) {}

  FailureKind kind() const { return kind_; }

 private:
  FailureKind kind_;
};

}  // namespace Bmcip
