// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "bmcip/model/Vocabulary.h"
#include "bmcip/output/Drawing.h"
#include "bmcip/output/Text.h"

namespace {

using namespace Bmcip;

TEST(TextTest, SteersNoTerminal) {
  EXPECT_EQ(harmless("a\033[2Jb\nc\x7f"), "a?[2Jb?c?");
  EXPECT_EQ(harmless("\xc2\x9b"
                     "31m"),
            "?31m");
  EXPECT_EQ(harmless("Müller → 1"), "Müller → 1");
  EXPECT_EQ(harmless("\xc2\xa0 \xc2"), "\xc2\xa0 \xc2");
}

TEST(TextTest, AlignsByCharacters) {
  EXPECT_EQ(tableOf({{"NAME", "X"}, {"Müll", "1"}, {"", "2"}}, {}, " "), " NAME  X\n Müll  1\n -     2\n");
}

TEST(TextTest, HasWordsForCodes) {
  EXPECT_EQ(wordOf("AddressOrigin", "4"), "DHCP");
  EXPECT_EQ(wordOf("AddressOrigin", "99"), "code 99");
  EXPECT_EQ(wordOf("AddressOrigin", ""), "");
}

TEST(TextTest, DrawsNamesThatAreHostile) {
  const Graph graph{{{"ComputerSystem", "a\"];\\x\033"}, {"IPProtocolEndPoint", "b"}}, {{"IPHosted\"", 0, 1}}};
  EXPECT_EQ(treeOf(graph), "a\"];\\x?\n└─ IPHosted\": b\n");
  EXPECT_NE(dotOf(graph).find(R"(n0 [label = "ComputerSystem\na\"];\\x?"];)"), std::string::npos) << dotOf(graph);
}

TEST(TextTest, DrawsACircleOnce) {
  const Graph graph{{{"ComputerSystem", "a"}, {"X", "b"}}, {{"to", 0, 1}, {"back", 1, 0}}};
  EXPECT_EQ(treeOf(graph), "a\n└─ to\n   └─ b\n      └─ back: a\n");
}

}  // namespace
