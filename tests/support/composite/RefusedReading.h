// SPDX-License-Identifier: Apache-2.0
// Stands in for the agent's textEqual, as RecordingLog does for its log: a test makes the factory take a class for
// another one and so refuse to read it. No answer of a broker does that for any class but the computer system's.
#pragma once

#include <string>

namespace Testing {

// The next reading of that composite class is refused; none if it is empty, as at the start of every test.
void refuseNextReading(const std::string& compositeClass);

}  // namespace Testing
