// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "factory/IPConfigObjectFactory.h"

namespace {

using QV::IPConfigComposite::IPConfigObjectFactory;
using Tokens = std::vector<std::string>;

Tokens tokensOf(const std::string& text, const std::string& delimiters = ":") {
  Tokens tokens;
  IPConfigObjectFactory().Tokenize(text, tokens, delimiters);
  return tokens;
}

TEST(TokenizeTest, SplitsAtEveryDelimiter) {
  EXPECT_EQ(tokensOf("BMC:eth0:static"), (Tokens{"BMC", "eth0", "static"}));
}

TEST(TokenizeTest, ATextWithoutDelimitersIsOnePiece) { EXPECT_EQ(tokensOf("BMC"), Tokens{"BMC"}); }

TEST(TokenizeTest, EmptyPiecesVanish) {
  EXPECT_EQ(tokensOf("BMC::a:"), (Tokens{"BMC", "a"}));
  EXPECT_EQ(tokensOf(":BMC:a"), (Tokens{"BMC", "a"}));
  EXPECT_EQ(tokensOf(":::"), Tokens{});
  EXPECT_EQ(tokensOf(""), Tokens{});
}

TEST(TokenizeTest, TheDelimitersAreASetOfCharacters) {
  EXPECT_EQ(tokensOf("a:b;c", ":;"), (Tokens{"a", "b", "c"}));
  EXPECT_EQ(tokensOf("a:;b", ":;"), (Tokens{"a", "b"}));
}

TEST(TokenizeTest, AppendsToWhatIsThere) {
  Tokens tokens = {"first"};
  IPConfigObjectFactory().Tokenize("a:b", tokens, ":");
  EXPECT_EQ(tokens, (Tokens{"first", "a", "b"}));
}

}  // namespace
