// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace Ground {

// This machine's name as the system has it now; "localhost" if it has none.
std::string hostName();

}  // namespace Ground
