// SPDX-License-Identifier: Apache-2.0
// Text for people: what servers say must not steer their terminals.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Bmcip {

// Nothing where the output is no terminal, NO_COLOR is set, or the terminal is dumb.
struct Colours {
  const char* bold = "";
  const char* dim = "";
  const char* plain = "";

  static Colours of(int descriptor);
};

// The text with every control character, also those above ASCII, replaced by "?".
std::string harmless(std::string_view text);

// In characters, not bytes.
std::size_t widthOf(std::string_view text);

// Rows of cells in columns that are as wide as they must be, two blanks between them. The first row is the heading. An
// empty cell is a dash. Every line begins with the indentation.
std::string tableOf(const std::vector<std::vector<std::string>>& rows, const Colours& colours,
                    std::string_view indentation = "");

}  // namespace Bmcip
