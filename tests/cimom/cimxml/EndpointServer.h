// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "tests/cimom/cimxml/EndpointTest.h"

namespace Testing {

// The fixture's endpoint for a program that is no test.
class EndpointServer : public EndpointTest {
 public:
  using EndpointTest::endpoint_;
  using EndpointTest::request;

 private:
  void TestBody() override {}
};

}  // namespace Testing
