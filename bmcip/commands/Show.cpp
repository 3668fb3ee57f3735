// SPDX-License-Identifier: Apache-2.0
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <fstream>
#include <iostream>
#include <optional>

#include "bmcip/commands/Commands.h"
#include "bmcip/commands/Terminal.h"
#include "bmcip/output/Json.h"
#include "bmcip/output/Tables.h"

namespace Bmcip {
namespace {

Server serverOf(const std::string& text, const Options& options, const std::string& origin) {
  try {
    return parseServer(text, options.server);
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(origin + refusal.what());
  }
}

void readHosts(std::istream& stream, const std::string& name, const Options& options, std::vector<Server>& servers) {
  std::size_t number = 0;
  for (std::string line; std::getline(stream, line);) {
    ++number;
    line.erase(std::min(line.find('#'), line.size()));
    line.erase(line.find_last_not_of(" \t\r") + 1);
    line.erase(0, line.find_first_not_of(" \t"));
    if (!line.empty()) {
      servers.push_back(serverOf(line, options, name + ":" + std::to_string(number) + ": "));
    }
  }
}

std::vector<Server> serversOf(const Options& options) {
  std::vector<Server> servers;
  for (const std::string& host : options.hosts) {
    servers.push_back(serverOf(host, options, ""));
  }
  if (options.hostsFile == "-") {
    readHosts(std::cin, "standard input", options, servers);
  } else if (!options.hostsFile.empty()) {
    std::ifstream file(options.hostsFile);
    if (!file) {
      throw UsageError("--hosts: " + options.hostsFile + " cannot be read");
    }
    readHosts(file, options.hostsFile, options, servers);
  }
  if (servers.empty() && !options.hostsFile.empty()) {
    throw UsageError("--hosts: " + options.hostsFile + " names no server");
  }
  return servers;
}

// A connection is a descriptor, and some are kept open for the next question.
void allowDescriptors(std::size_t connections) {
  rlimit limit{};
  const rlim_t wanted = connections * 2 + 64;
  if (getrlimit(RLIMIT_NOFILE, &limit) == 0 && limit.rlim_cur < wanted) {
    limit.rlim_cur = std::min(wanted, limit.rlim_max);
    setrlimit(RLIMIT_NOFILE, &limit);
  }
}

// Asks many servers at once and prints what they show in the order in which they were named.
class Fleet {
 public:
  Fleet(Transport& transport, const Options& options, std::vector<Server> servers)
      : transport_(transport), options_(options), servers_(std::move(servers)), lines_(servers_.size()) {}

  int run() {
    Progress progress(servers_.size());
    const std::size_t first = std::min(options_.parallel, servers_.size());
    allowDescriptors(first);
    while (next_ < first) {
      askNext();
    }
    transport_.run([&] { progress.show(done_, failures_.size()); });
    progress.clear();
    if (!options_.json) {
      std::vector<std::vector<std::string>> rows = {fleetHeading()};
      rows.insert(rows.end(), std::make_move_iterator(lines_.begin()), std::make_move_iterator(lines_.end()));
      std::cout << tableOf(rows, Colours::of(STDOUT_FILENO));
    }
    std::cout << std::flush;
    reportFailures();
    return status_;
  }

 private:
  void askNext() {
    const std::size_t place = next_++;
    readProcessor(transport_, servers_[place], [this, place](const Reading& reading) {
      take(reading, place);
      if (next_ < servers_.size()) {
        askNext();
      }
    });
  }

  void take(const Reading& reading, std::size_t place) {
    ++done_;
    if (reading.failure) {
      failures_.emplace_back(place, reading.failure->what());
      status_ = std::max(status_, static_cast<int>(reading.failure->kind()));
    }
    if (!options_.json) {
      lines_[place] = fleetRowOf(reading);
      return;
    }
    lines_[place] = {jsonOf(reading)};
    for (; printed_ < lines_.size() && !lines_[printed_].empty(); ++printed_) {
      std::cout << lines_[printed_].front() << '\n';
      lines_[printed_] = {std::string()};
    }
  }

  void reportFailures() {
    if (failures_.empty()) {
      return;
    }
    std::ranges::sort(failures_);
    std::cerr << "bmcip: " << failures_.size() << " of " << servers_.size() << " servers failed:\n";
    for (const auto& [place, what] : failures_) {
      std::cerr << "  " << harmless(servers_[place].given) << ": " << harmless(what) << '\n';
    }
  }

  Transport& transport_;
  const Options& options_;
  const std::vector<Server> servers_;
  std::vector<std::vector<std::string>> lines_;  // empty: no answer yet
  std::vector<std::pair<std::size_t, std::string>> failures_;
  std::size_t next_ = 0;
  std::size_t done_ = 0;
  std::size_t printed_ = 0;
  int status_ = 0;
};

}  // namespace

int show(Transport& transport, const Options& options) {
  if (!options.hosts.empty() || !options.hostsFile.empty()) {
    return Fleet(transport, options, serversOf(options)).run();
  }
  if (!options.json) {
    std::cout << tablesOf(readProcessor(transport, options.server).processor, Colours::of(STDOUT_FILENO));
    return 0;
  }
  // The object says what failed; a person who reads along is told, too.
  return Fleet(transport, options, {options.server}).run();
}

}  // namespace Bmcip
