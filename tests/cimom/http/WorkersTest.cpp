// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <future>

#include "cimom/http/Workers.h"

namespace {

using Cimom::Http::Workers;

TEST(WorkersTest, HaveAPlaceForOneMoreJobOnceOneHasFreedItsOwn) {
  Workers workers(1, 0);
  std::promise<void> freed;
  std::promise<void> begun;
  std::promise<void> end;
  ASSERT_TRUE(workers.run([&] {
    workers.freePlace();
    freed.set_value();
    end.get_future().wait();
  }));
  freed.get_future().wait();

  EXPECT_TRUE(workers.run([&] { begun.set_value(); }));
  EXPECT_FALSE(workers.run([] {}));

  end.set_value();
  begun.get_future().wait();
}

}  // namespace
