// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/OpenEnumerations.h"

namespace {

using namespace Cimom::CimXml;
using namespace std::chrono_literals;

OpenEnumeration enumerationOf(std::vector<std::string> items, const std::string& user = "") {
  OpenEnumeration enumeration;
  enumeration.items = std::move(items);
  enumeration.user = user;
  enumeration.timeout = 10s;
  return enumeration;
}

class OpenEnumerationsTest : public testing::Test {
 protected:
  // The code of the OperationError that the action ends with; 0 for none.
  template <typename Action>
  static int codeOf(Action action) {
    try {
      action();
      return 0;
    } catch (const OperationError& error) {
      return error.code();
    }
  }

  int takeCode(const std::string& context, const std::string& user = "",
               PulledItem item = PulledItem::InstanceWithPath) {
    return codeOf([&] { open_.take(context, user, item); });
  }

  std::chrono::steady_clock::time_point now_;
  OpenEnumerations open_{[this] { return now_; }};
};

TEST_F(OpenEnumerationsTest, ReturnsWhatWasPutIn) {
  const std::string context = open_.add(enumerationOf({"a", "b"}));
  EXPECT_EQ(open_.count(context, ""), 2U);
  OpenEnumeration taken = open_.take(context, "", PulledItem::InstanceWithPath);
  EXPECT_THAT(taken.items, testing::ElementsAre("a", "b"));
  taken.next = 1;
  open_.putBack(context, std::move(taken));
  EXPECT_EQ(open_.count(context, ""), 1U);
}

TEST_F(OpenEnumerationsTest, NamesEveryContextAnew) {
  std::set<std::string> contexts;
  for (int i = 0; i < 50; ++i) {
    contexts.insert(open_.add(enumerationOf({"a"})));
  }
  EXPECT_EQ(contexts.size(), 50U);
  EXPECT_EQ(contexts.begin()->size(), 32U);
}

TEST_F(OpenEnumerationsTest, KnowsNothingThatIsClosedOrOut) {
  const std::string context = open_.add(enumerationOf({"a"}));
  OpenEnumeration taken = open_.take(context, "", PulledItem::InstanceWithPath);
  EXPECT_EQ(takeCode(context), cimInvalidEnumerationContext);
  open_.putBack(context, std::move(taken));
  open_.close(context, "");
  EXPECT_EQ(takeCode(context), cimInvalidEnumerationContext);
  EXPECT_EQ(codeOf([&] { open_.close(context, ""); }), cimInvalidEnumerationContext);
  EXPECT_EQ(codeOf([&] { open_.count("", ""); }), cimInvalidEnumerationContext);
}

TEST_F(OpenEnumerationsTest, BelongsToWhoOpenedIt) {
  const std::string context = open_.add(enumerationOf({"a"}, "ann"));
  EXPECT_EQ(takeCode(context, "bob"), cimInvalidEnumerationContext);
  EXPECT_EQ(codeOf([&] { open_.close(context, ""); }), cimInvalidEnumerationContext);
  EXPECT_EQ(takeCode(context, "ann"), 0);
}

TEST_F(OpenEnumerationsTest, IsReadWithTheOperationOfItsItems) {
  const std::string context = open_.add(enumerationOf({"a"}));
  EXPECT_EQ(takeCode(context, "", PulledItem::InstancePath), cimInvalidEnumerationContext);
  EXPECT_EQ(takeCode(context), 0);
}

TEST_F(OpenEnumerationsTest, ForgetsWhatNobodyReads) {
  const std::string context = open_.add(enumerationOf({"a", "b"}));
  now_ += 10s;
  open_.putBack(context, open_.take(context, "", PulledItem::InstanceWithPath));
  now_ += 10s;
  EXPECT_EQ(open_.count(context, ""), 2U);
  now_ += 1ms;
  EXPECT_EQ(takeCode(context), cimInvalidEnumerationContext);
}

TEST_F(OpenEnumerationsTest, BoundsHowManyAUserOpens) {
  for (std::size_t i = 0; i < OpenEnumerations::maxCountOfUser; ++i) {
    open_.add(enumerationOf({"a"}, "ann"));
  }
  EXPECT_EQ(codeOf([&] { open_.add(enumerationOf({"a"}, "ann")); }), cimServerLimitsExceeded);
  EXPECT_EQ(codeOf([&] { open_.add(enumerationOf({"a"}, "bob")); }), 0);
  now_ += 11s;
  EXPECT_EQ(codeOf([&] { open_.add(enumerationOf({"a"}, "ann")); }), 0);
}

TEST_F(OpenEnumerationsTest, BoundsHowManyAreOpen) {
  for (std::size_t i = 0; i < OpenEnumerations::maxCount; ++i) {
    open_.add(enumerationOf({"a"}, std::to_string(i)));
  }
  EXPECT_EQ(codeOf([&] { open_.add(enumerationOf({"a"}, "one more")); }), cimServerLimitsExceeded);
}

TEST_F(OpenEnumerationsTest, BoundsTheirBytesAndFreesThem) {
  const std::string half(OpenEnumerations::maxBytes / 2, 'x');
  const std::string first = open_.add(enumerationOf({half}));
  EXPECT_EQ(codeOf([&] { open_.add(enumerationOf({half})); }), cimServerLimitsExceeded);
  open_.close(first, "");
  EXPECT_EQ(codeOf([&] { open_.add(enumerationOf({half})); }), 0);
}

}  // namespace
