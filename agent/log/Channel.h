// SPDX-License-Identifier: Apache-2.0
// One of the two channels of messages, the log or the trace: its thresholds and where its messages go.
#pragma once

#include <atomic>
#include <string>

#include "agent/config/AgentConfiguration.h"
#include "agent/log/Line.h"
#include "agent/log/LogFile.h"

namespace TWLog {

class Channel {
 public:
  explicit Channel(QV::ChannelSettings settings);

  // Whether messages of that component and level go out: free of locks and allocations, since nearly every message of
  // an ordinary day ends here.
  bool passes(const std::string& component, int level) const noexcept;

  // The least level that passes for any component.
  int floor() const noexcept { return floor_; }

  // Sends a message that passed to its destination. One that the log file does not take goes to syslog, and the first
  // of them brings the reason with it.
  void send(const Message& message);

 private:
  void sendToFile(const Message& message);

  const QV::ChannelSettings settings_;
  const int floor_;
  LogFile file_;
  std::atomic<bool> fileFailed_ = false;
};

// A notice of the log itself, to syslog and to stderr: for the faults that it cannot report through itself.
void notify(const std::string& text);

}  // namespace TWLog
