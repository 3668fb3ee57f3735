// SPDX-License-Identifier: Apache-2.0
// Holds every struct of the CMPI headers to the sizes and offsets of the standard's binary interface.
#include <cmpift.h>
#include <gtest/gtest.h>

#include <cstddef>

namespace {

struct Row {
  const char* name;
  std::size_t offset, size, expectedOffset, expectedSize;
};

const Row rows[] = {
#define MEMBER(type, member, offset, size) \
  {#type "." #member, offsetof(type, member), sizeof(static_cast<type*>(nullptr)->member), offset, size},
#define WHOLE(type, size) {#type, 0, sizeof(type), 0, size},
#include "layout.inc"
};

TEST(CmpiLayoutTest, EveryStructAndMemberStandsWhereTheBinaryInterfaceHasIt) {
  ASSERT_GT(std::size(rows), 300u);
  for (const Row& row : rows) {
    EXPECT_EQ(row.offset, row.expectedOffset) << row.name;
    EXPECT_EQ(row.size, row.expectedSize) << row.name;
  }
}

}  // namespace
