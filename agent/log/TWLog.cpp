// SPDX-License-Identifier: Apache-2.0
#include <TWLog/TWLog.h>

#include <atomic>
#include <exception>
#include <limits>
#include <utility>

#include "agent/log/Channel.h"

namespace TWLog {
namespace {

QV::AgentConfiguration configuration() {
  try {
    return QV::readAgentConfiguration();
  } catch (const std::exception& error) {
    notify(std::string(error.what()) + "; logging with the defaults");
    return {};
  }
}

// No message of a lower level goes out; none is known before agent.ini has been read. Nearly every message of an
// ordinary day ends here.
struct Floors {
  std::atomic<int> log = std::numeric_limits<int>::min();
  std::atomic<int> trace = std::numeric_limits<int>::min();
};
constinit Floors floors;

// Both channels as agent.ini has them, read with the first message. A broken or missing file is reported once, and the
// defaults hold: a provider must not fail for its log's sake, and what it fails for must reach the log.
struct Channels {
  explicit Channels(const QV::AgentConfiguration& configuration) : log(configuration.log), trace(configuration.trace) {
    floors.log = log.floor();
    floors.trace = trace.floor();
  }

  static Channels& instance() {
    static Channels channels(configuration());
    return channels;
  }

  Channel log;
  Channel trace;
};

void sendWherePassed(Channel Channels::*channel, const Message& message) noexcept {
  try {
    Channel& chosen = Channels::instance().*channel;
    if (chosen.passes(message.component, message.level)) {
      chosen.send(message);
    }
  } catch (const std::exception&) {
    // Out of memory: the message is lost, the request that it is about is not.
  }
}

}  // namespace

TWMessageBuffer::TWMessageBuffer() = default;

TWMessageBuffer::~TWMessageBuffer() = default;

TWMessageBuffer& TWMessageBuffer::operator<<(const char* text) {
  if (text && text_.empty()) {
    text_ = std::string(text);  // as nearly every line is: room is made once, for no more than it takes
  } else if (text) {
    text_ += text;
  }
  return *this;
}

std::string str(TWMessageBuffer& buffer) {
  std::string text = std::move(buffer.text_);
  buffer.text_.clear();
  return text;
}

void TWLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& component,
                               int level, char*, int, int, const std::string& message) {
  if (level >= floors.log) {
    sendWherePassed(&Channels::log, {function, file, line, component, level, message});
  }
}

void TWLogger::traceLevelMessage(const char* function, const char* file, int line, const std::string& component,
                                 int level, char*, int, int, const std::string& message) {
  if (level >= floors.trace) {
    sendWherePassed(&Channels::trace, {function, file, line, component, level, message});
  }
}

}  // namespace TWLog
