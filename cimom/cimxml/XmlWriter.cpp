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

// A text up to its first character that is not plain.
std::string_view plainBeginning(std::string_view text) {
  const auto* end = text.begin();
  while (end != text.end() && plainBytes[static_cast<unsigned char>(*end)]) {
    ++end;
  }
  return {text.begin(), end};
}

}  // namespace

std::vector<std::string> XmlWriter::takePieces() {
  pieces_.emplace_back();
  xml_.resize(std::exchange(size_, 0));
  pieces_.back() = std::exchange(xml_, {});
  return std::exchange(pieces_, {});
}

std::string XmlWriter::take() {
  std::string document;
  for (const std::string& piece : std::exchange(pieces_, {})) {
    document += piece;
  }
  xml_.resize(std::exchange(size_, 0));
  return document.empty() ? std::exchange(xml_, {}) : document += std::exchange(xml_, {});
}

void XmlWriter::escape(std::string_view text, Place place) {
  while (!text.empty()) {
    const std::string_view plain = plainBeginning(text);
    put(plain);
    text.remove_prefix(plain.size());
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

// The first piece grows as it is needed. What a piece has no room for begins the next one, and the room for the ends of
// the open elements goes with it.
void XmlWriter::grow(std::size_t bytes) {
  constexpr std::size_t pieceSize = 16 << 10;
  if (xml_.size() < pieceSize) {
    xml_.resize(std::max(size_ + reserved_ + bytes, std::min(2 * xml_.size(), pieceSize)));
    return;
  }
  std::string next(std::max(reserved_ + bytes, pieceSize), '\0');
  pieces_.emplace_back();
  xml_.resize(std::exchange(size_, 0));
  pieces_.back() = std::exchange(xml_, std::move(next));
}

}  // namespace Cimom::CimXml
