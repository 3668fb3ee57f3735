// SPDX-License-Identifier: Apache-2.0
#include "agent/log/Channel.h"

#include <pthread.h>
#include <syslog.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <limits>
#include <utility>

namespace TWLog {
namespace {

using Destination = QV::ChannelSettings::Destination;

int leastThreshold(const QV::ChannelSettings& settings) {
  if (settings.destination == Destination::Off) {
    return std::numeric_limits<int>::max();
  }
  int least = settings.threshold;
  for (const auto& [component, threshold] : settings.componentThresholds) {
    least = std::min(least, threshold);
  }
  return least;
}

// The severities that syslog knows, by the level from which on each of them applies.
int priority(int level) {
  if (level >= 6000) {
    return LOG_ERR;
  }
  if (level >= 5000) {
    return LOG_WARNING;
  }
  return level >= 4000 ? LOG_INFO : LOG_DEBUG;
}

// openlog would change the name under which the whole object manager logs, so the facility goes with each message.
void sendToSyslog(const Message& message) {
  ::syslog(LOG_DAEMON | priority(message.level), "%s", describe(message).c_str());
}

// Asked of the kernel once in a process.
int processId() {
  static std::atomic<int> id = ::getpid();
  static const bool followsForks = ::pthread_atfork(nullptr, nullptr, [] { id = ::getpid(); }) == 0;
  return followsForks ? id.load() : ::getpid();
}

}  // namespace

Channel::Channel(QV::ChannelSettings settings)
    : settings_(std::move(settings)), floor_(leastThreshold(settings_)), file_(settings_.file) {}

bool Channel::passes(const std::string& component, int level) const noexcept {
  if (level < floor_ || settings_.destination == Destination::Off) {
    return false;
  }
  const auto named = settings_.componentThresholds.find(component);
  return level >= (named == settings_.componentThresholds.end() ? settings_.threshold : named->second);
}

void Channel::send(const Message& message) {
  switch (settings_.destination) {
    case Destination::Off:
      return;
    case Destination::Syslog:
      return sendToSyslog(message);
    case Destination::Stderr: {
      const std::string line = describe(message) + '\n';
      std::fwrite(line.data(), 1, line.size(), stderr);
      return;
    }
    case Destination::File:
      return sendToFile(message);
  }
}

void Channel::sendToFile(const Message& message) {
  const int error = file_.append(fileLine(std::chrono::system_clock::now(), processId(), message));
  if (error == 0) {
    fileFailed_ = false;
    return;
  }
  if (!fileFailed_.exchange(true)) {
    notify("the log file " + file_.path() + " cannot be written: " + std::strerror(error) +
           "; its messages go to syslog");
  }
  sendToSyslog(message);
}

void notify(const std::string& text) {
  const std::string line = "management agent: " + text + '\n';
  std::fwrite(line.data(), 1, line.size(), stderr);
  ::syslog(LOG_DAEMON | LOG_ERR, "%s", line.c_str());
}

}  // namespace TWLog
