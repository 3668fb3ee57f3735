// SPDX-License-Identifier: Apache-2.0
#include "tests/support/client/Cimomd.h"

#include <signal.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <stdexcept>

#include "Paths.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"

namespace Testing {
namespace {

std::vector<std::string> joined(std::vector<std::string> first, const std::vector<std::string>& second) {
  first.insert(first.end(), second.begin(), second.end());
  return first;
}

// The configuration file of this machine, where there is one, says nothing to a test.
std::vector<std::string> withConfiguration(std::vector<std::string> options) {
  if (std::find(options.begin(), options.end(), "--config") == options.end()) {
    options.insert(options.end(), {"--config", "/dev/null"});
  }
  // Who tests as root means it.
  if (geteuid() == 0 && std::find(options.begin(), options.end(), "--user") == options.end()) {
    options.insert(options.end(), {"--user", "root"});
  }
  return options;
}

}  // namespace

Cimomd::Cimomd(const std::vector<std::string>& options, const Environment& environment, const std::string& program)
    : process_(joined({program, "--port", "0"}, withConfiguration(options)), environment) {
  std::string output;
  poll([&] {
    output = process_.output();
    return output.ends_with('\n') || !process_.isRunning();
  });
  const auto colon = output.rfind(':');
  if (!output.starts_with("listening on ") || colon == std::string::npos) {
    throw std::runtime_error("cimomd does not listen: " + process_.errors());
  }
  port_ = static_cast<std::uint16_t>(std::stoul(output.substr(colon + 1)));
}

// What is killed has neither cleaned up nor written the counters of a coverage build.
Cimomd::~Cimomd() {
  if (process_.isRunning()) {
    process_.signal(SIGTERM);
    poll([this] { return !process_.isRunning(); }, std::chrono::seconds(10));
  }
}

std::vector<std::string> Cimomd::probeOptions() {
  return {"--schema",       SOURCE_DIR "/tests/support/probe/Probe.mof",
          "--registration", SOURCE_DIR "/tests/support/probe/Probe.reg",
          "--provider-dir", built("lib")};
}

std::string Cimomd::url(const std::string& object, const std::string& nameSpace) const {
  return "http://127.0.0.1:" + std::to_string(port_) + "/" + nameSpace + ":" + object;
}

Completed Cimomd::wbemcli(std::vector<std::string> operation, const std::string& object,
                          const std::vector<std::string>& more) const {
  operation.insert(operation.begin(), "wbemcli");
  operation.push_back(url(object));
  return run(joined(std::move(operation), more));
}

int Cimomd::stop() {
  process_.signal(SIGTERM);
  return process_.wait();
}

}  // namespace Testing
