// SPDX-License-Identifier: Apache-2.0
#include "tests/hosts/HostTest.h"

#include <algorithm>
#include <filesystem>

#include "tests/support/system/Pattern.h"

namespace Testing {
namespace {

ObjectManager* current = nullptr;
// The sections of agent.ini that the object manager runs with.
std::string served;

// "b="2",a="1"" as "a="1",b="2"".
std::string sorted(const std::string& keys) {
  static const Pattern key(R"(\w+="[^"]*")");
  std::vector<Pattern::Match> found = key.all(keys);
  std::sort(found.begin(), found.end());
  std::string text;
  for (const Pattern::Match& one : found) {
    text += (text.empty() ? "" : ",") + one[0];
  }
  return text;
}

}  // namespace

void HostTest::use(ObjectManager& objectManager) { current = &objectManager; }

ObjectManager& HostTest::host() { return *current; }

void HostTest::SetUp() {
  if (served != ObjectManager::simulatedProcessor()) {
    serve(ObjectManager::simulatedProcessor());
  }
  std::filesystem::remove(ObjectManager::stateFile());
}

void HostTest::serve(const std::string& processor) {
  host().configureAgent(processor);
  host().restart();
  served = processor;
}

std::string HostTest::canonical(const std::string& text) {
  static const Pattern nameSpace(R"re(([\w.:-]+/)?root/(cimv2|yrnse):?)re");
  static const Pattern keys(R"re(\w+="[^"]*"(,\w+="[^"]*")*)re");
  return keys.replaced(nameSpace.replaced(text, ""), sorted);
}

std::vector<std::string> HostTest::canonical(std::vector<std::string> texts) {
  for (std::string& text : texts) {
    text = canonical(text);
  }
  return texts;
}

std::map<std::string, std::string> HostTest::canonical(std::map<std::string, std::string> values) {
  for (auto& [name, value] : values) {
    value = canonical(value);
  }
  return values;
}

}  // namespace Testing
