// SPDX-License-Identifier: Apache-2.0
#include "cimom/schema/MofLexer.h"

#include <charconv>
#include <cstdint>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"

namespace Cimom {
namespace {

using Kind = MofToken::Kind;

bool isDigit(char letter) { return letter >= '0' && letter <= '9'; }

bool isNameStart(char letter) {
  return (lowerCase(letter) >= 'a' && lowerCase(letter) <= 'z') || letter == '_' ||
         static_cast<signed char>(letter) < 0;
}

bool isNamePart(char letter) { return isNameStart(letter) || isDigit(letter); }

bool isBlank(char letter) {
  return letter == ' ' || letter == '\t' || letter == '\r' || letter == '\n' || letter == '\f' || letter == '\v';
}

// Appends a UTF-16 code unit as UTF-8.
void appendUtf8(std::string& target, unsigned code) {
  if (code < 0x80) {
    target += static_cast<char>(code);
  } else if (code < 0x800) {
    target += static_cast<char>(0xC0 | (code >> 6));
    target += static_cast<char>(0x80 | (code & 0x3F));
  } else {
    target += static_cast<char>(0xE0 | (code >> 12));
    target += static_cast<char>(0x80 | ((code >> 6) & 0x3F));
    target += static_cast<char>(0x80 | (code & 0x3F));
  }
}

// The code of a text of one UTF-8 character of the basic plane; false for any other text.
bool singleCharacter(const std::string& text, CMPIChar16& code) {
  const auto byte = [&](std::size_t index) { return static_cast<unsigned char>(text[index]); };
  if (text.size() == 1 && byte(0) < 0x80) {
    code = byte(0);
  } else if (text.size() == 2 && byte(0) >> 5 == 6) {
    code = static_cast<CMPIChar16>((byte(0) & 0x1F) << 6 | (byte(1) & 0x3F));
  } else if (text.size() == 3 && byte(0) >> 4 == 14) {
    code = static_cast<CMPIChar16>((byte(0) & 0x0F) << 12 | (byte(1) & 0x3F) << 6 | (byte(2) & 0x3F));
  } else {
    return false;
  }
  return true;
}

}  // namespace

bool MofToken::isKeyword(std::string_view keyword) const { return kind == Kind::Name && sameName(text, keyword); }

std::string MofToken::describe() const {
  switch (kind) {
    case Kind::End:
      return "end of text";
    case Kind::String:
      return "the string \"" + text + "\"";
    default:
      return "\"" + text + "\"";
  }
}

MofLexer::MofLexer(std::string_view text, const std::string& origin) : text_(text), origin_(origin) {
  if (text_.starts_with("\xEF\xBB\xBF")) {
    text_.remove_prefix(3);
  }
}

void MofLexer::fail(unsigned line, const std::string& what) const {
  throw ConfigurationError(origin_ + ":" + std::to_string(line) + ": " + what);
}

char MofLexer::peek(std::size_t ahead) const {
  return position_ + ahead < text_.size() ? text_[position_ + ahead] : '\0';
}

void MofLexer::skipBlanks() {
  while (!atEnd()) {
    if (isBlank(peek())) {
      if (peek() == '\n') {
        ++line_;
      }
      ++position_;
    } else if (peek() == '/' && peek(1) == '/') {
      position_ = std::min(text_.find('\n', position_), text_.size());
    } else if (peek() == '/' && peek(1) == '*') {
      const unsigned start = line_;
      const std::size_t end = text_.find("*/", position_ + 2);
      if (end == std::string_view::npos) {
        fail(start, "unterminated comment");
      }
      for (; position_ < end + 2; ++position_) {
        line_ += peek() == '\n';
      }
    } else {
      return;
    }
  }
}

MofToken MofLexer::next() {
  skipBlanks();
  MofToken token;
  token.line = line_;
  if (atEnd()) {
    return token;
  }
  const char first = peek();
  if (isNameStart(first)) {
    const std::size_t start = position_;
    while (isNamePart(peek())) {
      ++position_;
    }
    token.kind = Kind::Name;
    token.text = text_.substr(start, position_ - start);
  } else if (first == '"') {
    token.kind = Kind::String;
    do {
      token.text += quoted('"');
      skipBlanks();
    } while (peek() == '"');
    token.value = Value::string(token.text);
  } else if (first == '\'') {
    token.kind = Kind::Character;
    token.text = quoted('\'');
    CMPIChar16 code = 0;
    if (!singleCharacter(token.text, code)) {
      fail(token.line, "'" + token.text + "' must be one character");
    }
    token.value = Value::char16(code);
  } else if (isDigit(first) ||
             ((first == '-' || first == '+' || first == '.') && (isDigit(peek(1)) || peek(1) == '.'))) {
    return number();
  } else if (std::string_view("{}[](),;:=#$").find(first) != std::string_view::npos) {
    token.kind = Kind::Punctuation;
    token.text = first;
    ++position_;
  } else {
    fail(line_, std::string("unexpected character \"") + first + "\"");
  }
  return token;
}

std::string MofLexer::quoted(char quote) {
  const unsigned start = line_;
  std::string result;
  for (++position_; !atEnd() && peek() != '\n'; ++position_) {
    if (peek() == quote) {
      ++position_;
      return result;
    }
    if (peek() == '\\') {
      ++position_;
      escape(result);
    } else {
      result += peek();
    }
  }
  fail(start, quote == '"' ? "unterminated string" : "unterminated character");
}

// Takes the escape sequence that the position is at, up to its last character.
void MofLexer::escape(std::string& target) {
  constexpr std::string_view letters = "btnfr\"'\\";
  constexpr std::string_view meanings = "\b\t\n\f\r\"'\\";
  if (const std::size_t index = letters.find(peek()); index != std::string_view::npos && !atEnd()) {
    target += meanings[index];
    return;
  }
  if (lowerCase(peek()) == 'x') {
    const std::string_view digits = text_.substr(position_ + 1, 4);
    unsigned code = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), code, 16);
    if (error == std::errc() && end != digits.data()) {
      appendUtf8(target, code);
      position_ += static_cast<std::size_t>(end - digits.data());
      return;
    }
  }
  fail(line_, "unknown escape sequence");
}

// Decimal, octal (0…), hexadecimal (0x…), binary (…b) and real numbers.
MofToken MofLexer::number() {
  const std::size_t start = position_;
  while (isNamePart(peek()) || peek() == '.' ||
         ((peek() == '-' || peek() == '+') &&
          (position_ == start || (lowerCase(text_[position_ - 1]) == 'e' && !text_.substr(start, 2).ends_with('x'))))) {
    ++position_;
  }
  MofToken token;
  token.kind = Kind::Integer;
  token.line = line_;
  token.text = text_.substr(start, position_ - start);

  std::string_view digits = token.text;
  const bool negative = digits.starts_with('-');
  if (negative || digits.starts_with('+')) {
    digits.remove_prefix(1);
  }
  int base = 10;
  if (digits.size() > 2 && digits[0] == '0' && lowerCase(digits[1]) == 'x') {
    base = 16;
    digits.remove_prefix(2);
  } else if (digits.size() > 1 && lowerCase(digits.back()) == 'b') {
    base = 2;
    digits.remove_suffix(1);
  } else if (digits.find_first_of(".eE") != std::string_view::npos) {
    double real = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), real);
    if (error != std::errc() || end != digits.data() + digits.size()) {
      fail(line_, token.describe() + " is not a number");
    }
    token.kind = Kind::Real;
    token.value = Value::real64(negative ? -real : real);
    return token;
  } else if (digits.size() > 1 && digits[0] == '0') {
    base = 8;
  }
  std::uint64_t magnitude = 0;
  const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), magnitude, base);
  constexpr std::uint64_t lowest = std::uint64_t(1) << 63;
  if (error != std::errc() || end != digits.data() + digits.size() || (negative && magnitude > lowest)) {
    fail(line_, token.describe() + " is not a 64-bit number");
  }
  token.value = negative ? Value::sint64(static_cast<CMPISint64>(0 - magnitude)) : Value::uint64(magnitude);
  return token;
}

}  // namespace Cimom
