// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/hosts/ObjectManager.h"

namespace Testing {

// A test of the product as the object manager serves it. Each begins with a simulated management processor in its
// factory state, and must leave the object manager serving.
class HostTest : public testing::Test {
 public:
  // The object manager under test, for the program's life.
  static void use(ObjectManager& objectManager);

 protected:
  void SetUp() override;

  // Restarts the object manager on a management processor that the sections of agent.ini describe.
  static void serve(const std::string& processor);

  static ObjectManager& host();

  // Texts with the paths in them in one form, since object managers order keys and print references in their own ways:
  // without hosts and namespaces, keys in the order of their names.
  static std::string canonical(const std::string& text);
  static std::vector<std::string> canonical(std::vector<std::string> texts);
  static std::map<std::string, std::string> canonical(std::map<std::string, std::string> values);
};

}  // namespace Testing
