// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/DocumentLimits.h"

#include <algorithm>
#include <array>
#include <set>
#include <string>

#include "cimom/cimxml/Errors.h"
#include "ground/Names.h"

namespace Cimom::CimXml {
namespace {

// The text as the characters that XML's markup is made of; any other one may show as something else that is none.
class Markup {
 public:
  explicit Markup(std::string_view xml) : xml_(xml) {
    using namespace std::string_view_literals;
    if (xml.starts_with("\xFE\xFF") || xml.starts_with("\0<"sv)) {
      width_ = 2;
      high_ = 0;
    } else if (xml.starts_with("\xFF\xFE") || xml.starts_with("<\0"sv)) {
      width_ = 2;
      high_ = 1;
    }
    if (xml.starts_with("\xEF\xBB\xBF")) {
      xml_.remove_prefix(3);
    } else if (xml.starts_with("\xFE\xFF") || xml.starts_with("\xFF\xFE")) {
      xml_.remove_prefix(2);
    }
  }

  bool isWide() const { return width_ == 2; }
  std::size_t size() const { return xml_.size() / width_; }

  char operator[](std::size_t index) const {
    if (width_ == 1) {
      return xml_[index];
    }
    return xml_[index * 2 + high_] == '\0' ? xml_[index * 2 + 1 - high_] : '?';
  }

  bool has(std::size_t index, std::string_view text) const {
    if (size() < index + text.size()) {
      return false;
    }
    for (std::size_t i = 0; i < text.size(); ++i) {
      if ((*this)[index + i] != text[i]) {
        return false;
      }
    }
    return true;
  }

  std::string text(std::size_t begin, std::size_t end) const {
    std::string text;
    for (; begin < end; ++begin) {
      text += (*this)[begin];
    }
    return text;
  }

 private:
  std::string_view xml_;
  std::size_t width_ = 1;  // bytes of a character
  std::size_t high_ = 0;   // which of two is the upper one
};

bool isBlank(char character) { return character == ' ' || character == '\t' || character == '\r' || character == '\n'; }

class Scan {
 public:
  explicit Scan(std::string_view xml) : markup_(xml) {}

  void run() {
    if (markup_.size() == 0 || !(markup_[0] == '<' || isBlank(markup_[0]))) {
      refuse("request-not-well-formed", "the message must begin with <");
    }
    while (position_ < markup_.size()) {
      if (current() != '<') {
        advance();
        continue;
      }
      countNode();
      if (markup_.has(position_, "<!--")) {
        skipTo("-->");
      } else if (markup_.has(position_, "<![CDATA[")) {
        skipTo("]]>");
      } else if (markup_.has(position_, "<?")) {
        readInstruction();
      } else {
        readTag();
      }
    }
  }

 private:
  char current() const { return markup_[position_]; }

  void advance() {
    const char character = current();
    if (character == '\0') {
      refuse("request-not-well-formed", "the message contains a null character");
    }
    line_ += character == '\n' ? 1 : 0;
    ++position_;
  }

  void skipTo(std::string_view end) {
    while (position_ < markup_.size() && !markup_.has(position_, end)) {
      advance();
    }
  }

  void readInstruction() {
    const std::size_t begin = position_;
    skipTo("?>");
    if (begin == 0) {
      requireReadable(markup_.text(begin, position_));
    }
  }

  // An encoding in which other bytes are the markup, such as EBCDIC or UTF-7, would show the parser other tags.
  void requireReadable(const std::string& declaration) const {
    const auto begin = declaration.find_first_of("\"'", declaration.find("encoding"));
    if (declaration.find("encoding") == std::string::npos || begin == std::string::npos) {
      return;
    }
    std::string encoding = declaration.substr(begin + 1, declaration.find(declaration[begin], begin + 1) - begin - 1);
    std::ranges::transform(encoding, encoding.begin(), Ground::lowerCase);
    static constexpr std::array<std::string_view, 5> narrow = {"utf-8", "us-ascii", "ascii", "iso-8859-",
                                                               "windows-125"};
    const bool readable =
        markup_.isWide()
            ? encoding.starts_with("utf-16")
            : std::ranges::any_of(narrow, [&](std::string_view known) { return encoding.starts_with(known); });
    if (!readable) {
      refuse("request-not-well-formed", "the encoding must be UTF-8 or UTF-16, not " + encoding);
    }
  }

  void readTag() {
    advance();
    const bool isEnd = position_ < markup_.size() && current() == '/';
    const std::size_t begin = position_;
    while (position_ < markup_.size() && !isBlank(current()) && current() != '>' && current() != '/') {
      refuseBracket();
      advance();
    }
    if (!isEnd) {
      countName(markup_.text(begin, position_));
    }
    readAttributes(markup_.has(begin, "!"));
  }

  // Whatever begins with <, but the end of an element, becomes a node in the parser's memory.
  void countNode() {
    if (!markup_.has(position_, "</") && ++nodes_ > DocumentLimits::elements) {
      refuse("request-not-valid",
             "more than " + std::to_string(DocumentLimits::elements) + " elements, comments and the like");
    }
  }

  void countName(const std::string& name) {
    names_.insert(name);
    if (names_.size() > DocumentLimits::elementNames) {
      refuse("request-not-valid", "more than " + std::to_string(DocumentLimits::elementNames) + " different elements");
    }
  }

  void readAttributes(bool isDeclaration) {
    std::size_t attributes = 0;
    char quote = '\0';
    for (; position_ < markup_.size() && (quote || current() != '>'); advance()) {
      refuseBracket();
      if (quote) {
        quote = current() == quote ? '\0' : quote;
      } else if (current() == '"' || current() == '\'') {
        quote = current();
      } else if (current() == '[' && isDeclaration) {
        refuse("request-not-well-formed", "the message declares entities or attributes");
      } else if (current() == '=' && ++attributes > DocumentLimits::attributes) {
        refuse("request-not-valid", "more than " + std::to_string(DocumentLimits::attributes) + " attributes");
      }
    }
  }

  // A tag within a tag: the parser goes on at another place than this scan would.
  void refuseBracket() const {
    if (current() == '<') {
      refuse("request-not-well-formed", "< is not allowed in a tag");
    }
  }

  [[noreturn]] void refuse(const char* cimError, const std::string& what) const {
    throw TransportError(400, cimError, "line " + std::to_string(line_) + ": " + what);
  }

  const Markup markup_;
  std::size_t position_ = 0;
  std::size_t line_ = 1;
  std::size_t nodes_ = 0;
  std::set<std::string> names_;
};

}  // namespace

void requireWithinLimits(std::string_view xml) { Scan(xml).run(); }

}  // namespace Cimom::CimXml
