// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <string_view>

#include "cimom/model/Value.h"

namespace Cimom {

// What MOF texts are made of.
struct MofToken {
  enum class Kind { End, Name, String, Integer, Real, Character, Punctuation };

  Kind kind = Kind::End;
  std::string text;  // a name or punctuation as written, a string without its quotes and escapes
  Value value;       // of a string (CMPI_string), a number (CMPI_uint64, CMPI_sint64, CMPI_real64) or a character
  unsigned line = 0;

  bool is(std::string_view punctuation) const { return kind == Kind::Punctuation && text == punctuation; }
  // Keywords are found without regard to case.
  bool isKeyword(std::string_view keyword) const;
  // The token as a message names it.
  std::string describe() const;
};

// Cuts a MOF text into tokens. Comments and blanks are passed over, adjacent strings are one.
class MofLexer {
 public:
  // Both must outlive the lexer.
  MofLexer(std::string_view text, const std::string& origin);

  // The next token; End for ever after the last.
  // Throws ConfigurationError "ORIGIN:LINE: what is wrong".
  MofToken next();

  [[noreturn]] void fail(unsigned line, const std::string& what) const;

 private:
  void skipBlanks();
  bool atEnd() const { return position_ == text_.size(); }
  char peek(std::size_t ahead = 0) const;
  std::string quoted(char quote);
  void escape(std::string& target);
  MofToken number();

  std::string_view text_;
  const std::string& origin_;
  std::size_t position_ = 0;
  unsigned line_ = 1;
};

}  // namespace Cimom
