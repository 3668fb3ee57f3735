// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <string>

#include "cimom/model/NamedList.h"

namespace {

struct Named {
  std::string name;
  int number;
};

using Names = Cimom::NamedList<Named>;

TEST(NamedListTest, FindsEveryElementWithoutRegardToCase) {
  Names names;
  EXPECT_EQ(names.find("Name0"), nullptr);
  for (int number = 0; number < 300; ++number) {
    names.push_back({"Name" + std::to_string(number), number});
    for (int earlier = 0; earlier <= number; ++earlier) {
      const Named* found = names.find("nAME" + std::to_string(earlier));
      ASSERT_NE(found, nullptr) << earlier;
      EXPECT_EQ(found->number, earlier);
      EXPECT_EQ(names.indexOf(*found), static_cast<std::size_t>(earlier));
    }
    EXPECT_EQ(names.find("Name" + std::to_string(number + 1)), nullptr);
  }
  EXPECT_EQ(names.find(""), nullptr);
}

TEST(NamedListTest, FindsTheFirstOfOneName) {
  Names names;
  names.push_back({"Name", 1});
  names.push_back({"NAME", 2});
  for (int number = 3; number < 20; ++number) {
    names.push_back({std::to_string(number), number});
    EXPECT_EQ(names.find("name")->number, 1);
  }
  EXPECT_EQ(names.size(), 19U);
  EXPECT_EQ(names[1].number, 2);
}

TEST(NamedListTest, FindsNothingOnceItIsCleared) {
  Names names;
  names.push_back({"Name", 1});
  names.clear();
  EXPECT_EQ(names.find("Name"), nullptr);
  EXPECT_TRUE(names.empty());
  names.push_back({"Name", 2});
  EXPECT_EQ(names.find("Name")->number, 2);
}

}  // namespace
