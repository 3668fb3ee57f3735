// SPDX-License-Identifier: Apache-2.0
#include "bmcip/output/Text.h"

#include <unistd.h>

#include <algorithm>
#include <cstdlib>

namespace Bmcip {

Colours Colours::of(int descriptor) {
  const char* noColour = std::getenv("NO_COLOR");
  const char* terminal = std::getenv("TERM");
  const bool wanted = isatty(descriptor) == 1 && !(noColour && *noColour) && terminal &&
                      std::string_view(terminal) != "dumb" && *terminal;
  return wanted ? Colours{"\033[1m", "\033[2m", "\033[0m"} : Colours{};
}

std::string harmless(std::string_view text) {
  std::string result;
  for (std::size_t i = 0; i < text.size(); ++i) {
    const auto byte = static_cast<unsigned char>(text[i]);
    if (byte < 0x20 || byte == 0x7f) {
      result += '?';
    } else if (byte == 0xc2 && i + 1 < text.size() && static_cast<unsigned char>(text[i + 1]) < 0xa0) {
      result += '?';  // U+0080 to U+009F
      ++i;
    } else {
      result += text[i];
    }
  }
  return result;
}

std::size_t widthOf(std::string_view text) {
  return static_cast<std::size_t>(
      std::ranges::count_if(text, [](char byte) { return (static_cast<unsigned char>(byte) & 0xc0) != 0x80; }));
}

std::string tableOf(const std::vector<std::vector<std::string>>& rows, const Colours& colours,
                    std::string_view indentation) {
  std::vector<std::vector<std::string>> cells = rows;
  std::vector<std::size_t> widths;
  for (auto& row : cells) {
    widths.resize(std::max(widths.size(), row.size()));
    for (std::size_t i = 0; i < row.size(); ++i) {
      row[i] = row[i].empty() ? "-" : harmless(row[i]);
      widths[i] = std::max(widths[i], widthOf(row[i]));
    }
  }
  std::string table;
  for (const auto& row : cells) {
    std::string line;
    for (std::size_t i = 0; i < row.size(); ++i) {
      line += row[i];
      if (i + 1 < row.size()) {
        line.append(widths[i] - widthOf(row[i]) + 2, ' ');
      }
    }
    const bool isHeading = &row == &cells.front();
    table += std::string(indentation) + (isHeading ? colours.dim : "") + line + (isHeading ? colours.plain : "") + '\n';
  }
  return table;
}

}  // namespace Bmcip
