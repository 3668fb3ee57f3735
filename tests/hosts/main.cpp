// SPDX-License-Identifier: Apache-2.0
// hosts_test OBJECT_MANAGER [separately]: holds the product in a running object manager. Enters a machine of its own
// before anything is changed, so that what is installed on this one stays as it is.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <exception>
#include <iostream>

#include "Paths.h"
#include "tests/hosts/HostTest.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;

constexpr int skipped = 77;
constexpr const char* insideVariable = "HOSTS_TEST_INSIDE";

int fail(const std::string& reason) {
  std::cerr << "hosts_test: " << reason << '\n';
  return 1;
}

// Runs the program once more, on a private machine. Comes back only if that cannot be.
int enterPrivateMachine(char** argv, const std::string& prefix) {
  setenv(insideVariable, "1", 1);
  std::vector<std::string> command = {SOURCE_DIR "/tests/hosts/private-machine", prefix, INSTALL_PREFIX,
                                      buildDirectory(), "--"};
  for (char** argument = argv; *argument; ++argument) {
    command.emplace_back(*argument);
  }
  std::vector<char*> words;
  for (std::string& word : command) {
    words.push_back(word.data());
  }
  words.push_back(nullptr);
  execv(words.front(), words.data());
  return fail(command.front() + ": " + std::strerror(errno));
}

class ServedProduct : public testing::Environment {
 public:
  explicit ServedProduct(ObjectManager& objectManager) : objectManager_(objectManager) {}

  void SetUp() override {
    try {
      objectManager_.install();
    } catch (const std::exception& error) {
      FAIL() << error.what();
    }
  }

  void TearDown() override {
    try {
      objectManager_.stop();
    } catch (const std::exception& error) {
      FAIL() << error.what();
    }
  }

 private:
  ObjectManager& objectManager_;
};

}  // namespace

int main(int argc, char** argv) {
  std::vector<char*> original(argv, argv + argc + 1);
  testing::InitGoogleMock(&argc, argv);
  if (argc < 2 || argc > 3 || (argc == 3 && std::strcmp(argv[2], "separately") != 0)) {
    return fail("usage: hosts_test sfcb|openpegasus [separately] [GoogleTest's options]");
  }
  try {
    const auto objectManager = ObjectManager::find(argv[1], argc == 3 ? 2 : 1);
    if (!objectManager) {
      std::cout << "hosts_test: skipped: " << ObjectManager::variableOf(argv[1]) << " does not say where " << argv[1]
                << " is installed\n";
      return skipped;
    }
    if (const std::string missing = objectManager->missing(); !missing.empty()) {
      return fail(ObjectManager::variableOf(argv[1]) + ": " + missing);
    }
    if (!std::getenv(insideVariable)) {
      return enterPrivateMachine(original.data(), objectManager->prefix());
    }
    HostTest::use(*objectManager);
    testing::AddGlobalTestEnvironment(new ServedProduct(*objectManager));
    return RUN_ALL_TESTS();
  } catch (const std::exception& error) {
    return fail(error.what());
  }
}
