// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/XmlWriter.h"

#include <algorithm>
#include <array>
#include <new>
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

}  // namespace

XmlWriter::XmlWriter(Prolog prolog) {
  if (prolog == Prolog::Declared) {
    xml_ = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";
  }
}

XmlWriter::Scope::~Scope() {
  try {
    writer_.endTag(name_);
  } catch (const std::bad_alloc&) {
    writer_.isCut_ = true;
  }
}

XmlWriter::Scope XmlWriter::element(const char* name) {
  closeStartTag();
  xml_.append("<").append(name);
  inStartTag_ = true;
  return {*this, name};
}

XmlWriter::Scope XmlWriter::element(const char* name, const char* attributeName, std::string_view attributeValue) {
  closeStartTag();
  xml_.append("<").append(name);
  inStartTag_ = true;
  attribute(attributeName, attributeValue);
  return {*this, name};
}

void XmlWriter::attribute(const char* name, std::string_view value) {
  xml_.append(" ").append(name).append("=\"");
  append(value, Place::AttributeValue);
  xml_.append("\"");
}

void XmlWriter::text(std::string_view text) {
  closeStartTag();
  append(text, Place::Content);
}

void XmlWriter::textElement(const char* name, std::string_view content) {
  const auto scope = element(name);
  text(content);
}

void XmlWriter::written(std::string_view xml) {
  closeStartTag();
  xml_.append(xml);
}

std::string XmlWriter::take() {
  if (isCut_) {
    throw std::bad_alloc();
  }
  return std::move(xml_);
}

void XmlWriter::endTag(const char* name) {
  closeStartTag();
  xml_.append("</").append(name).append(">");
}

void XmlWriter::closeStartTag() {
  if (inStartTag_) {
    xml_.append(">");
    inStartTag_ = false;
  }
}

void XmlWriter::append(std::string_view text, Place place) {
  while (!text.empty()) {
    const auto* const special = std::find_if_not(
        text.begin(), text.end(), [](char byte) { return plainBytes[static_cast<unsigned char>(byte)]; });
    const auto plain = static_cast<std::size_t>(special - text.begin());
    xml_.append(text.substr(0, plain));
    text.remove_prefix(plain);
    if (text.empty()) {
      return;
    }
    if (const auto escaped = reference(text.front(), place == Place::AttributeValue); !escaped.empty()) {
      xml_.append(escaped);
      text.remove_prefix(1);
      continue;
    }
    const XmlCharacter character = firstXmlCharacter(text);
    xml_.append(character.text);
    text.remove_prefix(character.size);
  }
}

}  // namespace Cimom::CimXml
