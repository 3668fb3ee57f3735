#pragma once

#include <string>

namespace Ground {

// This machine's name as the system has it now; "localhost" if it has none.
std::string hostName();

}  // namespace Ground
