// SPDX-License-Identifier: Apache-2.0
#include "tests/support/client/WbemClient.h"

#include <gtest/gtest.h>

#include <sstream>

namespace Testing {

std::vector<std::string> linesOf(const std::string& output) {
  std::vector<std::string> lines;
  std::istringstream stream(output);
  for (std::string line; std::getline(stream, line);) {
    if (!line.empty()) {
      lines.push_back(line);
    }
  }
  return lines;
}

std::vector<Printed> instancesOf(const std::string& output) {
  std::vector<Printed> instances;
  for (const std::string& line : linesOf(output)) {
    if (line.front() != '-') {
      instances.push_back({line, {}, {}});
      continue;
    }
    const auto equals = line.find('=');
    const std::string name = line.substr(1, equals - 1);
    instances.back().names.push_back(name);
    if (equals + 1 < line.size()) {
      instances.back().values[name] = line.substr(equals + 1);
    }
  }
  return instances;
}

std::string withoutHost(const std::string& path) { return path.substr(path.find('/') + 1); }

std::string objectOf(const std::string& path) {
  const std::string local = withoutHost(path);
  return local.substr(local.find(':') + 1);
}

std::string WbemClient::url(const std::string& object, const std::string& nameSpace) const {
  return "http://127.0.0.1:" + std::to_string(port()) + "/" + nameSpace + ":" + object;
}

Completed WbemClient::wbemcli(const std::string& operation, const std::string& object,
                              const std::vector<std::string>& more, const std::string& nameSpace) const {
  std::vector<std::string> command = {"wbemcli"};
  std::istringstream words(operation);
  for (std::string word; words >> word;) {
    command.push_back(word);
  }
  command.push_back(url(object, nameSpace));
  command.insert(command.end(), more.begin(), more.end());
  return run(command);
}

std::vector<std::string> WbemClient::paths(const std::string& operation, const std::string& object,
                                           const std::string& nameSpace) const {
  const Completed completed = wbemcli(operation, object, {}, nameSpace);
  EXPECT_EQ(completed.status, 0) << operation << ' ' << object << '\n' << completed.errors;
  return linesOf(completed.output);
}

std::vector<std::string> WbemClient::names(const std::string& operation, const std::string& object,
                                           const std::string& nameSpace) const {
  std::vector<std::string> names = paths(operation, object, nameSpace);
  for (std::string& name : names) {
    name = objectOf(name);
  }
  return names;
}

std::vector<Printed> WbemClient::instances(const std::string& operation, const std::string& object,
                                           const std::string& properties, const std::string& nameSpace) const {
  const std::vector<std::string> more = properties.empty() ? std::vector<std::string>{} : std::vector{properties};
  const Completed completed = wbemcli(operation + " -nl", object, more, nameSpace);
  EXPECT_EQ(completed.status, 0) << operation << ' ' << object << '\n' << completed.errors;
  return instancesOf(completed.output);
}

std::map<std::string, std::string> WbemClient::get(const std::string& object, const std::string& nameSpace) const {
  const std::vector<Printed> found = instances("gi", object, {}, nameSpace);
  EXPECT_EQ(found.size(), 1U) << object;
  return found.empty() ? std::map<std::string, std::string>{} : found.front().values;
}

void WbemClient::modify(const std::string& object, const std::string& values) const {
  const Completed completed = wbemcli("mi", object, {values});
  EXPECT_EQ(completed.status, 0) << object << ' ' << values << '\n' << completed.errors;
}

std::string WbemClient::failure(const std::string& operation, const std::string& object,
                                const std::vector<std::string>& more, const std::string& nameSpace) const {
  const Completed completed = wbemcli(operation, object, more, nameSpace);
  EXPECT_NE(completed.status, 0) << operation << ' ' << object << '\n' << completed.output;
  return completed.errors;
}

}  // namespace Testing
