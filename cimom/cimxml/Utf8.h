// SPDX-License-Identifier: Apache-2.0
// UTF-8, held to what an XML 1.0 document can carry.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace Cimom::CimXml {

// A character as XML carries it, and how many bytes of a text it stands for.
struct XmlCharacter {
  std::string_view text;
  std::size_t size;
};

// The first character of a text that is not empty. U+FFFD stands for a byte that is not UTF-8, and for a character that
// XML 1.0 (2.2) has no way to write: most control characters, surrogates, U+FFFE and U+FFFF.
XmlCharacter firstXmlCharacter(std::string_view text);

// The code point of a text of exactly one character.
std::optional<char32_t> decodeOne(std::string_view text);

std::string encode(char32_t codePoint);

}  // namespace Cimom::CimXml
