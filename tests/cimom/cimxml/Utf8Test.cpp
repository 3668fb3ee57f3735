// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "cimom/cimxml/Utf8.h"

namespace {

using namespace Cimom::CimXml;

constexpr const char* replacement = "\xEF\xBF\xBD";

std::string toXmlText(std::string_view text) {
  std::string result;
  while (!text.empty()) {
    const XmlCharacter first = firstXmlCharacter(text);
    result += first.text;
    text.remove_prefix(first.size);
  }
  return result;
}

TEST(Utf8Test, KeepsWhatXmlCanCarry) {
  for (const char* text : {"", "plain", "tab\tline\nreturn\r", "\x7F", "äöü€", "\xF0\x9F\x98\x80", "\xED\x9F\xBF"}) {
    EXPECT_EQ(toXmlText(text), text);
  }
}

TEST(Utf8Test, ReplacesControlCharacters) {
  EXPECT_EQ(toXmlText("a\x01"
                      "b\x1F"
                      "c"),
            std::string("a") + replacement + "b" + replacement + "c");
  EXPECT_EQ(toXmlText(std::string_view("\0", 1)), replacement);
}

TEST(Utf8Test, ReplacesEveryByteOfWhatIsNoUtf8) {
  EXPECT_EQ(toXmlText("\xFF"), replacement);
  EXPECT_EQ(toXmlText("a\x80"), std::string("a") + replacement);
  EXPECT_EQ(toXmlText("\xE2\x82"), std::string(replacement) + replacement);  // cut off
  EXPECT_EQ(toXmlText("\xC0\xAF"), std::string(replacement) + replacement);  // longer than needed
  EXPECT_EQ(toXmlText("\xF8\x88\x80\x80"), std::string(replacement) + replacement + replacement + replacement);
  EXPECT_EQ(toXmlText("\xE2(x"), std::string(replacement) + "(x");  // the next character stays
}

TEST(Utf8Test, ReplacesCodePointsThatAreNoCharacters) {
  EXPECT_EQ(toXmlText("\xEF\xBF\xBE"), replacement);                                           // U+FFFE
  EXPECT_EQ(toXmlText("\xED\xA0\x80"), std::string(replacement) + replacement + replacement);  // a surrogate
  EXPECT_EQ(toXmlText("\xF4\x90\x80\x80").substr(0, 3), replacement);                          // beyond U+10FFFF
}

TEST(Utf8Test, DecodesExactlyOneCharacter) {
  EXPECT_EQ(decodeOne("A"), U'A');
  EXPECT_EQ(decodeOne("€"), U'€');
  EXPECT_EQ(decodeOne(""), std::nullopt);
  EXPECT_EQ(decodeOne("AB"), std::nullopt);
  EXPECT_EQ(decodeOne("\xFF"), std::nullopt);
}

TEST(Utf8Test, EncodesWhatItDecodes) {
  for (const char32_t codePoint : {U'A', U'ä', U'€', U'\U0001F600'}) EXPECT_EQ(decodeOne(encode(codePoint)), codePoint);
  EXPECT_EQ(encode(0xD800), replacement);
}

}  // namespace
