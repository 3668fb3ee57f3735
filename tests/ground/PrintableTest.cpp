// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "ground/Printable.h"

namespace {

using Ground::printable;

TEST(PrintableTest, LeavesTextAsItIs) {
  EXPECT_EQ(printable("eth0: \"an\\address\" über 100 €"), "eth0: \"an\\address\" über 100 €");
  EXPECT_EQ(printable(""), "");
}

TEST(PrintableTest, ShowsWhatWouldEndALineOrSteerATerminal) {
  EXPECT_EQ(printable("a\nb\r\tc\x7f"), "a\\x0ab\\x0d\\x09c\\x7f");
  EXPECT_EQ(printable("\x1b[2J"), "\\x1b[2J");
  EXPECT_EQ(printable(std::string_view("a\0b", 3)), "a\\x00b");
  EXPECT_EQ(printable("\xc2\x9b"
                      "2J"),
            "\\xc2\\x9b2J");
  EXPECT_EQ(printable("\xc2"), "\xc2");
}

}  // namespace
