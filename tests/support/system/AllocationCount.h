// SPDX-License-Identifier: Apache-2.0
// How often the program has allocated with operator new, for tests of code that must not.
#pragma once

namespace Testing {

long allocationCount();

}  // namespace Testing
