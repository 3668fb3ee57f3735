// SPDX-License-Identifier: Apache-2.0
// The tests, or with options of its own the campaign that tools/faults runs.
#include <gtest/gtest.h>

#include <charconv>
#include <cstring>
#include <fstream>
#include <iostream>
#include <stdexcept>

#include "tests/faults/Campaign.h"

namespace {

using namespace Testing;

constexpr const char* usage =
    "usage: faults_test [--gtest_...]                    the tests: a share of the points\n"
    "       faults_test --all [--of TEXT] [--every N] [--jobs N] [--failures FILE]\n"
    "                                                    every point, or every N-th, of the requests whose name has "
    "TEXT\n"
    "       faults_test --point REQUEST@CALL:FAULT       one of them, in this process\n"
    "       faults_test --calls REQUEST                  the calls that a request makes\n"
    "       faults_test --requests                       the names of all requests\n";

std::size_t numberOf(const std::string& text) {
  std::size_t number = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  if (error != std::errc() || *end != '\0' || number == 0) {
    throw std::invalid_argument("\"" + text + "\" must be a number from 1");
  }
  return number;
}

int runAll(const std::vector<std::string>& options) {
  std::string part;
  std::string file;
  std::size_t every = 1;
  std::size_t jobs = 1;
  for (std::size_t i = 0; i < options.size(); i += 2) {
    if (i + 1 == options.size()) {
      throw std::invalid_argument(options[i] + " needs a value");
    }
    const std::string& value = options[i + 1];
    if (options[i] == "--of") {
      part = value;
    } else if (options[i] == "--every") {
      every = numberOf(value);
    } else if (options[i] == "--jobs") {
      jobs = numberOf(value);
    } else if (options[i] == "--failures") {
      file = value;
    } else {
      throw std::invalid_argument("unknown option " + options[i]);
    }
  }
  const Report report = carryOut(share(points(part), every), static_cast<unsigned>(jobs));
  std::ofstream failures(file);
  constexpr std::size_t shown = 20;
  for (std::size_t i = 0; i < report.failures.size(); ++i) {
    if (i < shown) {
      std::cout << report.failures[i] << '\n';
    }
    failures << report.failures[i] << '\n';
  }
  std::cout << report;
  return report.failed() == 0 ? 0 : 1;
}

int runOne(const std::string& name) {
  const Point point = pointOf(name);
  std::cout << record(Who::Product, *point.request)[point.call - 1].text << '\n' << std::flush;
  const Finding finding = check(point);
  std::cout << (finding.verdict == Verdict::Held ? "held" : finding.detail) << '\n';
  return finding.verdict == Verdict::Held ? 0 : 1;
}

int showCalls(const std::string& name) {
  std::size_t number = 0;
  for (const RecordedCall& call : record(Who::Product, requestOf(name))) {
    std::cout << ++number << ' ' << call.text << '\n';
  }
  return 0;
}

int showRequests() {
  for (const Request& request : requests()) {
    std::cout << request.name() << '\n';
  }
  return 0;
}

int runCampaign(const std::vector<std::string>& arguments) {
  const std::string& what = arguments.front();
  const std::vector<std::string> rest(arguments.begin() + 1, arguments.end());
  if (what == "--all") {
    return runAll(rest);
  }
  if (what == "--point" && rest.size() == 1) {
    return runOne(rest.front());
  }
  if (what == "--calls" && rest.size() == 1) {
    return showCalls(rest.front());
  }
  if (what == "--requests" && rest.empty()) {
    return showRequests();
  }
  throw std::invalid_argument("unknown arguments");
}

}  // namespace

int main(int argc, char** argv) {
  if (argc > 1 && std::strncmp(argv[1], "--gtest", 7) != 0) {
    try {
      return runCampaign({argv + 1, argv + argc});
    } catch (const std::invalid_argument& error) {
      std::cerr << "faults_test: " << error.what() << '\n' << usage;
      return 2;
    }
  }
  ::testing::InitGoogleTest(&argc, argv);
  return RUN_ALL_TESTS();
}
