// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Utf8.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace Cimom::CimXml {
namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";

struct Decoded {
  char32_t codePoint;
  std::size_t size;  // bytes; 0: no UTF-8
};

// A lead byte's form: how many bytes follow, and the least code point that needs so many.
struct LeadForm {
  unsigned char mask;
  unsigned char pattern;
  std::size_t size;
  char32_t least;
};

constexpr std::array<LeadForm, 4> leadForms = {
    {{0x80, 0x00, 1, 0}, {0xE0, 0xC0, 2, 0x80}, {0xF0, 0xE0, 3, 0x800}, {0xF8, 0xF0, 4, 0x10000}}};

bool isSurrogate(char32_t codePoint) { return codePoint >= 0xD800 && codePoint <= 0xDFFF; }

// Takes a text that is not empty.
Decoded decode(std::string_view text) {
  const auto lead = static_cast<unsigned char>(text[0]);
  const auto* const form = std::find_if(leadForms.begin(), leadForms.end(), [lead](const LeadForm& candidate) {
    return (lead & candidate.mask) == candidate.pattern;
  });
  if (form == leadForms.end() || form->size > text.size()) {
    return {0, 0};
  }
  char32_t codePoint = lead & static_cast<unsigned char>(~form->mask);
  for (std::size_t i = 1; i < form->size; ++i) {
    const auto byte = static_cast<unsigned char>(text[i]);
    if ((byte & 0xC0) != 0x80) {
      return {0, 0};
    }
    codePoint = codePoint << 6 | (byte & 0x3F);
  }
  if (codePoint < form->least || codePoint > 0x10FFFF || isSurrogate(codePoint)) {
    return {0, 0};
  }
  return {codePoint, form->size};
}

bool isXmlCharacter(char32_t codePoint) {
  if (codePoint < 0x20) {
    return codePoint == '\t' || codePoint == '\n' || codePoint == '\r';
  }
  return codePoint != 0xFFFE && codePoint != 0xFFFF;
}

}  // namespace

XmlCharacter firstXmlCharacter(std::string_view text) {
  const Decoded decoded = decode(text);
  const bool isGood = decoded.size > 0 && isXmlCharacter(decoded.codePoint);
  return {isGood ? text.substr(0, decoded.size) : replacement, std::max<std::size_t>(decoded.size, 1)};
}

std::optional<char32_t> decodeOne(std::string_view text) {
  if (text.empty()) {
    return std::nullopt;
  }
  const Decoded decoded = decode(text);
  if (decoded.size != text.size()) {
    return std::nullopt;
  }
  return decoded.codePoint;
}

std::string encode(char32_t codePoint) {
  if (isSurrogate(codePoint) || codePoint > 0x10FFFF) {
    return std::string(replacement);
  }
  const auto tail = [codePoint](unsigned shift) { return static_cast<char>(0x80 | (codePoint >> shift & 0x3F)); };
  const auto lead = [codePoint](unsigned pattern, unsigned shift) {
    return static_cast<char>(pattern | codePoint >> shift);
  };
  if (codePoint < 0x80) {
    return {static_cast<char>(codePoint)};
  }
  if (codePoint < 0x800) {
    return {lead(0xC0, 6), tail(0)};
  }
  if (codePoint < 0x10000) {
    return {lead(0xE0, 12), tail(6), tail(0)};
  }
  return {lead(0xF0, 18), tail(12), tail(6), tail(0)};
}

}  // namespace Cimom::CimXml
