// SPDX-License-Identifier: Apache-2.0
// The text of what an operation throws; a failed expectation where it throws nothing.
#pragma once

#include <gtest/gtest.h>

#include <exception>
#include <string>

namespace Testing {

template <typename Operation>
std::string thrownBy(const Operation& operation) {
  try {
    operation();
  } catch (const std::exception& error) {
    return error.what();
  }
  ADD_FAILURE() << "nothing was thrown";
  return {};
}

}  // namespace Testing
