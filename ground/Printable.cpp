// SPDX-License-Identifier: Apache-2.0
#include "ground/Printable.h"

namespace Ground {
namespace {

constexpr unsigned char firstPrintable = 0x20;
constexpr unsigned char deleteCharacter = 0x7f;
constexpr unsigned char c1Lead = 0xc2;  // in UTF-8 the control characters U+0080 to U+009F are C2 80 to C2 9F
constexpr unsigned char c1Last = 0x9f;

void appendHex(std::string& line, unsigned char byte) {
  constexpr const char* digits = "0123456789abcdef";
  line += "\\x";
  line += digits[byte >> 4];
  line += digits[byte & 0xf];
}

}  // namespace

std::string printable(std::string_view text) {
  std::string line;
  line.reserve(text.size());
  for (std::size_t i = 0; i < text.size(); ++i) {
    const auto byte = static_cast<unsigned char>(text[i]);
    const auto next = static_cast<unsigned char>(i + 1 < text.size() ? text[i + 1] : 0);
    if (byte == c1Lead && next > deleteCharacter && next <= c1Last) {
      appendHex(line, byte);
      appendHex(line, next);
      ++i;
    } else if (byte < firstPrintable || byte == deleteCharacter) {
      appendHex(line, byte);
    } else {
      line += text[i];
    }
  }
  return line;
}

}  // namespace Ground
