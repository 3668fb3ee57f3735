// SPDX-License-Identifier: Apache-2.0
#include "tests/hosts/HostTest.h"

#include <algorithm>
#include <filesystem>
#include <regex>

namespace Testing {
namespace {

ObjectManager* current = nullptr;
// The sections of agent.ini that the object manager runs with.
std::string served;

// "b="2",a="1"" as "a="1",b="2"".
std::string sorted(const std::string& keys) {
  static const std::regex key(R"(\w+="[^"]*")");
  std::vector<std::string> found(std::sregex_token_iterator(keys.begin(), keys.end(), key), {});
  std::sort(found.begin(), found.end());
  std::string text;
  for (const std::string& one : found) {
    text += (text.empty() ? "" : ",") + one;
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
  static const std::regex nameSpace(R"re(([\w.:-]+/)?root/(cimv2|yrnse):?)re");
  static const std::regex keys(R"re(\w+="[^"]*"(,\w+="[^"]*")*)re");
  const std::string local = std::regex_replace(text, nameSpace, "");
  std::string result;
  auto rest = local.cbegin();
  for (std::sregex_iterator found(local.begin(), local.end(), keys), end; found != end; ++found) {
    result.append(rest, (*found)[0].first).append(sorted((*found)[0]));
    rest = (*found)[0].second;
  }
  return result.append(rest, local.cend());
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
