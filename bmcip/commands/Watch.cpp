// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <ctime>
#include <iostream>
#include <optional>
#include <thread>

#include "bmcip/commands/Commands.h"
#include "bmcip/output/Json.h"
#include "bmcip/output/Text.h"

namespace Bmcip {
namespace {

using Facts = std::vector<std::pair<std::string, std::string>>;

std::string now() {
  const std::time_t time = std::time(nullptr);
  std::tm local{};
  localtime_r(&time, &local);
  char text[32];
  std::strftime(text, sizeof text, "%FT%T%z", &local);
  std::string stamp = text;
  return stamp.insert(stamp.size() - 2, ":");
}

std::string valueOf(const Facts& facts, const std::string& what) {
  const auto found = std::ranges::find(facts, what, &Facts::value_type::first);
  return found == facts.end() ? "" : found->second;
}

class Watch {
 public:
  Watch(const Options& options) : options_(options) {}

  void take(const std::optional<Facts>& facts, const std::string& failure) {
    if (failure != failure_) {
      print("server", failure_.empty() ? "answering" : failure_, failure.empty() ? "answering" : failure);
      failure_ = failure;
    }
    if (!facts) {
      return;
    }
    if (facts_) {
      compare(*facts_, *facts);
    }
    facts_ = facts;
  }

 private:
  void compare(const Facts& before, const Facts& after) const {
    for (const auto& [what, value] : after) {
      if (const std::string earlier = valueOf(before, what); earlier != value) {
        print(what, earlier, value);
      }
    }
    for (const auto& [what, value] : before) {
      if (!value.empty() && std::ranges::find(after, what, &Facts::value_type::first) == after.end()) {
        print(what, value, "");
      }
    }
  }

  void print(const std::string& what, const std::string& before, const std::string& after) const {
    const Event event{now(), options_.server.given, what, before, after};
    const auto shown = [](const std::string& text) { return text.empty() ? "-" : text; };
    std::cout << (options_.json ? jsonOf(event)
                                : event.time + "  " + harmless(what + ": " + shown(before) + " -> " + shown(after)))
              << std::endl;
  }

  const Options& options_;
  std::optional<Facts> facts_;
  std::string failure_;
};

}  // namespace

int watch(Transport& transport, const Options& options) {
  Watch watch(options);
  // What cannot be watched at the beginning is a mistake; what fails later is news.
  watch.take(readProcessor(transport, options.server).processor.facts(), "");
  std::cerr << "bmcip: watching " << harmless(options.server.given) << "; ^C ends it" << std::endl;
  while (std::cout) {
    std::this_thread::sleep_for(options.interval);
    try {
      watch.take(readProcessor(transport, options.server).processor.facts(), "");
    } catch (const Failure& failure) {
      watch.take(std::nullopt, failure.what());
    }
  }
  return 1;
}

}  // namespace Bmcip
