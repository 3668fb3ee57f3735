// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "cimom/model/Shared.h"

namespace {

using Cimom::Shared;

// Counts itself.
struct Counted {
  Counted() { ++alive; }
  Counted(const Counted& other) : text(other.text) { ++alive; }
  Counted& operator=(const Counted&) = delete;
  ~Counted() { --alive; }

  std::string text = "original";
  static inline int alive = 0;
};

TEST(SharedTest, CopiesAreOneObject) {
  const Shared<Counted> one{Counted()};
  const Shared<Counted> other = one;
  EXPECT_EQ(&*one, &*other);
  EXPECT_EQ(Counted::alive, 1);
}

TEST(SharedTest, AChangeIsSeenInOneCopyAlone) {
  Shared<Counted> one{Counted()};
  const Shared<Counted> other = one;
  one.own().text = "changed";
  EXPECT_EQ(one->text, "changed");
  EXPECT_EQ(other->text, "original");
  EXPECT_EQ(Counted::alive, 2);
}

TEST(SharedTest, ALoneObjectIsChangedWhereItIs) {
  Shared<Counted> one{Counted()};
  const Counted* const before = &*one;
  { const Shared<Counted> gone = one; }
  EXPECT_EQ(&one.own(), before);
}

TEST(SharedTest, TheLastCopyTakesTheObjectWithIt) {
  {
    Shared<Counted> one{Counted()};
    Shared<Counted> other = one;
    Shared<Counted> moved = std::move(one);
    other = Shared<Counted>{Counted()};
    EXPECT_EQ(Counted::alive, 2);
    moved = other;
    EXPECT_EQ(Counted::alive, 1);
  }
  EXPECT_EQ(Counted::alive, 0);
}

}  // namespace
