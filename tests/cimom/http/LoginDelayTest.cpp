// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "cimom/http/LoginDelay.h"

namespace {

using namespace Cimom::Http;
using namespace std::chrono_literals;

class LoginDelayTest : public testing::Test {
 protected:
  // The wait of an attempt that comes now.
  LoginDelay::Clock::duration attempt(const std::string& address, const std::string& user) {
    return delay_.admit(address, user, now_).value_or(LoginDelay::Clock::duration::max());
  }

  void fail(int times, const std::string& address, const std::string& user) {
    for (int i = 0; i < times; ++i) {
      delay_.failed(address, user, now_);
    }
  }

  LoginDelay delay_;
  LoginDelay::Clock::time_point now_ = LoginDelay::Clock::now();
};

TEST_F(LoginDelayTest, LetsSomebodyMistype) {
  fail(2, "192.0.2.1", "admin");
  EXPECT_EQ(attempt("192.0.2.1", "admin"), 0s);
}

TEST_F(LoginDelayTest, GrowsWithEveryFailure) {
  auto last = 0ns;
  for (int i = 0; i < 5; ++i) {
    fail(i == 0 ? 3 : 1, "192.0.2.1", "admin");
    const auto wait = attempt("192.0.2.1", "admin");
    EXPECT_GT(wait, last);
    last = wait;
    now_ += 60s;
  }
  fail(100, "192.0.2.1", "admin");
  EXPECT_EQ(attempt("192.0.2.1", "admin"), 8s);
}

TEST_F(LoginDelayTest, LeavesOtherUsersAndAddressesAlone) {
  fail(10, "192.0.2.1", "admin");
  EXPECT_EQ(attempt("192.0.2.1", "operator"), 0s);
  EXPECT_EQ(attempt("192.0.2.2", "admin"), 0s);
}

TEST_F(LoginDelayTest, SlowsAnAddressThatTriesManyUsers) {
  for (int i = 0; i < 30; ++i) {
    fail(1, "192.0.2.1", "user" + std::to_string(i));
  }
  EXPECT_GT(attempt("192.0.2.1", "another"), 0s);
  EXPECT_EQ(attempt("192.0.2.2", "another"), 0s);
}

TEST_F(LoginDelayTest, QueuesAttemptsSideBySideAndRefusesTooMany) {
  fail(10, "192.0.2.1", "admin");
  const auto first = attempt("192.0.2.1", "admin");
  const auto second = attempt("192.0.2.1", "admin");
  EXPECT_GE(second, first + 8s);
  attempt("192.0.2.1", "admin");
  EXPECT_EQ(delay_.admit("192.0.2.1", "admin", now_), std::nullopt);
}

TEST_F(LoginDelayTest, ForgetsWhoHasLoggedIn) {
  fail(10, "192.0.2.1", "admin");
  delay_.succeeded("192.0.2.1", "admin");
  EXPECT_EQ(attempt("192.0.2.1", "admin"), 0s);
}

TEST_F(LoginDelayTest, KeepsWhoIsSlowedWhereManyOthersFail) {
  fail(10, "192.0.2.1", "admin");
  for (int i = 0; i < 10000; ++i) {
    fail(1, "198.51.100.1", "user" + std::to_string(i));
  }
  EXPECT_GT(attempt("192.0.2.1", "admin"), 0s);
}

}  // namespace
