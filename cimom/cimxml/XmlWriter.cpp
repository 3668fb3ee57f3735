// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/XmlWriter.h"

#include <algorithm>
#include <array>
#include <new>
#include <utility>

#include "cimom/cimxml/Utf8.h"

namespace Cimom::CimXml {
namespace {

using namespace std::literals;

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

XmlWriter::XmlWriter(Prolog prolog) {
  if (prolog == Prolog::Declared) {
    put("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"sv);
  }
}

XmlWriter::Scope::~Scope() {
  try {
    writer_.endTag(name_);
  } catch (const std::bad_alloc&) {
    writer_.isCut_ = true;
  }
}

XmlWriter::Scope XmlWriter::element(std::string_view name) {
  closeStartTag();
  put("<"sv, name);
  inStartTag_ = true;
  return {*this, name};
}

XmlWriter::Scope XmlWriter::element(std::string_view name, std::string_view attributeName,
                                    std::string_view attributeValue) {
  closeStartTag();
  put("<"sv, name);
  inStartTag_ = true;
  attribute(attributeName, attributeValue);
  return {*this, name};
}

void XmlWriter::attribute(std::string_view name, std::string_view value) {
  put(" "sv, name, "=\""sv);
  escape(value, Place::AttributeValue);
  put("\""sv);
}

void XmlWriter::text(std::string_view text) {
  closeStartTag();
  escape(text, Place::Content);
}

void XmlWriter::textElement(std::string_view name, std::string_view content) {
  const auto scope = element(name);
  text(content);
}

void XmlWriter::written(std::string_view xml) {
  closeStartTag();
  put(xml);
}

std::string XmlWriter::take() {
  if (isCut_) {
    throw std::bad_alloc();
  }
  xml_.resize(std::exchange(size_, 0));
  return std::exchange(xml_, {});
}

void XmlWriter::endTag(std::string_view name) {
  closeStartTag();
  put("</"sv, name, ">"sv);
}

void XmlWriter::closeStartTag() {
  if (inStartTag_) {
    put(">"sv);
    inStartTag_ = false;
  }
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

template <typename... Pieces>
void XmlWriter::put(Pieces... pieces) {
  char* at = room((pieces.size() + ...));
  ((at = std::copy(pieces.begin(), pieces.end(), at)), ...);
  size_ = static_cast<std::size_t>(at - xml_.data());
}

char* XmlWriter::room(std::size_t bytes) {
  if (xml_.size() - size_ < bytes) {
    grow(bytes);
  }
  return xml_.data() + size_;
}

void XmlWriter::grow(std::size_t bytes) { xml_.resize(std::max(size_ + bytes, 2 * xml_.size())); }

}  // namespace Cimom::CimXml
