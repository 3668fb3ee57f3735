// SPDX-License-Identifier: Apache-2.0
// UTF-8, held to what an XML 1.0 document can carry.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace Cimom::CimXml {

// The text with every byte sequence that is not UTF-8, and every character that XML 1.0 (2.2) has no way to write (most
// control characters, surrogates, U+FFFE and U+FFFF), replaced by U+FFFD.
std::string toXmlText(std::string_view text);

// The code point of a text of exactly one character.
std::optional<char32_t> decodeOne(std::string_view text);

std::string encode(char32_t codePoint);

}  // namespace Cimom::CimXml
