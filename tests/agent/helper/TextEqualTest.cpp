// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <gtest/gtest.h>

namespace {

using namespace QV;

TEST(TextEqualTest, IgnoresTheCaseOfAsciiLetters) {
  EXPECT_TRUE(textEqual("BMC", "bmc"));
  EXPECT_TRUE(textEqual("YRNx_MgmtHwClientAccess", "yrnX_mGMTHWCLIENTACCESS"));
}

TEST(TextEqualTest, TellsDifferentTextsApart) {
  EXPECT_FALSE(textEqual("BMC", "BMD"));
  EXPECT_FALSE(textEqual("BMC", "BMC1"));
  EXPECT_FALSE(textEqual("BMC1", "BMC"));
  EXPECT_FALSE(textEqual("", "a"));
}

TEST(TextEqualTest, TakesNothingButLettersForLetters) {
  // '@' and '`', '[' and '{' differ as upper and lower letters do
  EXPECT_FALSE(textEqual("@", "`"));
  EXPECT_FALSE(textEqual("[", "{"));
  EXPECT_FALSE(textEqual("\xc4", "\xe4")) << "beyond ASCII bytes count as they are";
}

TEST(TextEqualTest, FindsEmptyTextsEqual) { EXPECT_TRUE(textEqual("", "")); }

TEST(TextEqualTest, FindsANullEqualToNothing) {
  EXPECT_FALSE(textEqual(nullptr, "a"));
  EXPECT_FALSE(textEqual("a", nullptr));
  EXPECT_FALSE(textEqual(nullptr, nullptr));
}

}  // namespace
