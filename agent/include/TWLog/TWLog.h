// SPDX-License-Identifier: Apache-2.0
// The management agent's logging library (libtwlog): a log and a trace, filtered by component and level.
//
// These declarations are a contract between separately built libraries: another set of libraries with the same symbols
// can stand in place of ours without a rebuild of the providers. Document them; do not add to them.
#pragma once

#include <string>

namespace TWLog {

// Collects the text of one line.
class TWMessageBuffer {
 public:
  TWMessageBuffer();
  ~TWMessageBuffer();

  // Appends a C string; a null appends nothing.
  TWMessageBuffer& operator<<(const char* text);

 private:
  friend std::string str(TWMessageBuffer& buffer);
  std::string text_;
};

// Takes the collected text out of the buffer, which is empty afterwards: a line that is streamed once for the log and
// once more for the trace reaches each of them once.
std::string str(TWMessageBuffer& buffer);

// Sends a message to the log or to the trace where `level` reaches the channel's threshold for `component`. Levels grow
// with severity: 4000 is progress, 6000 is failure. The location is that of the code that reports. The unnamed
// parameters are not used by this product.
class TWLogger {
 public:
  static void logLevelMessage(const char* function, const char* file, int line, const std::string& component, int level,
                              char*, int, int, const std::string& message);
  static void traceLevelMessage(const char* function, const char* file, int line, const std::string& component,
                                int level, char*, int, int, const std::string& message);
};

}  // namespace TWLog
