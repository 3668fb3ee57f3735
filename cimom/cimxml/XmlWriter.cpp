// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/XmlWriter.h"

#include <algorithm>
#include <array>
#include <utility>

#include "cimom/cimxml/Utf8.h"

namespace Cimom::CimXml {
namespace {

constexpr bool isPlain(unsigned char byte) {
  return byte >= 0x20 && byte < 0x7F && byte != '&' && byte != '<' && byte != '>' && byte != '"';
}

constexpr std::array<bool, 256> plainBytes = [] {
  std::array<bool, 256> plain{};
  for (unsigned byte = 0; byte < plain.size(); ++byte) {
    plain[byte] = isPlain(static_cast<unsigned char>(byte));
  }
  return plain;
}();

// What must be written for a character that the parser would take for markup, or would not give back as it was: a
// carriage return anywhere, other white space in an attribute's value. Empty for any other.
std::string_view reference(char character, bool inAttributeValue) {
  switch (character) {
    case '&':
      return "&amp;";
    case '<':
      return "&lt;";
    case '>':
      return "&gt;";
    case '"':
      return "&quot;";
    case '\r':
      return "&#13;";
    case '\n':
      return inAttributeValue ? "&#10;" : "";
    case '\t':
      return inAttributeValue ? "&#9;" : "";
    default:
      return "";
  }
}

struct Copied {
  std::string_view::iterator read;
  char* written;
};

// Copies a text up to its first character that is not plain.
Copied copyPlain(std::string_view text, char* to) {
  const auto* from = text.begin();
  while (from != text.end() && plainBytes[static_cast<unsigned char>(*from)]) {
    *to++ = *from++;
  }
  return {from, to};
}

}  // namespace

std::string XmlWriter::take() {
  xml_.resize(std::exchange(size_, 0));
  return std::exchange(xml_, {});
}

void XmlWriter::escape(std::string_view text, Place place) {
  while (!text.empty()) {
    char* const begin = room(text.size());
    const auto [special, end] = copyPlain(text, begin);
    size_ += static_cast<std::size_t>(end - begin);
    text.remove_prefix(static_cast<std::size_t>(special - text.begin()));
    if (text.empty()) {
      return;
    }
    if (const auto escaped = reference(text.front(), place == Place::AttributeValue); !escaped.empty()) {
      put(escaped);
      text.remove_prefix(1);
      continue;
    }
    const XmlCharacter character = firstXmlCharacter(text);
    put(character.text);
    text.remove_prefix(character.size);
  }
}

void XmlWriter::grow(std::size_t bytes) { xml_.resize(std::max(size_ + reserved_ + bytes, 2 * xml_.size())); }

}  // namespace Cimom::CimXml
