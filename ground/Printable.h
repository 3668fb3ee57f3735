// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <string_view>

namespace Ground {

// The text for a line of a log: control characters, which could end the line or steer a terminal, as "\x0a".
std::string printable(std::string_view text);

}  // namespace Ground
