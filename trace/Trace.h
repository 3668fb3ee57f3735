// SPDX-License-Identifier: Apache-2.0
// The trace and log frame: every operation of every provider and every member of the factory reports through it, so
// that an administrator can follow a request line by line in the agent's log and trace.
//
// A line is formatted into one of two static buffers that all callers share without a lock: a line costs no allocation
// for its text, and threads that trace at the same moment may garble each other's diagnostic text, nothing else. Every
// line is formatted, whatever the agent's thresholds are, so it is done without printf.
#pragma once

#include <TWLog/TWLog.h>

#include <algorithm>
#include <charconv>
#include <cstring>
#include <iterator>
#include <limits>
#include <string>
#include <string_view>

namespace QV {

enum MessageType : int {
  EntryMessage = 0,
  ExitMessage = 1,
  MethodInvokedMessage = 2,
  FreeMessage = 3,
};

namespace IPConfigComposite::TraceDetail {

using Buffer = char[512];

// A text that may be null, which is an empty one.
inline std::string_view viewOf(const char* text) { return text ? text : ""; }

// The digits of a line's number, signed as printf's %d shows it.
class Number {
 public:
  explicit Number(unsigned int line)
      : end_(std::to_chars(std::begin(characters_), std::end(characters_), static_cast<int>(line)).ptr) {}
  Number(const Number&) = delete;
  Number& operator=(const Number&) = delete;

  operator std::string_view() const { return {characters_, static_cast<std::size_t>(end_ - characters_)}; }

 private:
  char characters_[std::numeric_limits<int>::digits10 + 2];
  const char* end_;
};

// Clears a buffer and writes pieces into it, one after another, as far as they go before the null at its end. In line,
// so that literals are copied by a length that is known.
template <typename... Pieces>
[[gnu::always_inline]] inline void write(Buffer& buffer, const Pieces&... pieces) {
  // The C library's, which knows the processor: in place of a plain memset the compiler puts string instructions.
  ::explicit_bzero(buffer, sizeof buffer);
  char* next = buffer;
  const auto copy = [&](std::string_view piece, std::size_t size) {
    std::memcpy(next, piece.data(), size);
    next += size;
  };
  if ((std::string_view(pieces).size() + ...) < sizeof buffer) {
    (copy(pieces, std::string_view(pieces).size()), ...);
  } else {
    const auto room = [&] { return static_cast<std::size_t>(buffer + sizeof buffer - 1 - next); };
    (copy(pieces, std::min(std::string_view(pieces).size(), room())), ...);
  }
}

}  // namespace IPConfigComposite::TraceDetail

// Formats a line about a function (`text` is its name) or, as FreeMessage, a message (`text` is the message). A type
// that is none of the four yields the empty text; a line longer than 511 characters is cut. The result is valid until
// the next call of this overload anywhere in the library.
inline char* trace(std::string_view file, std::string_view text, unsigned int line, MessageType type) {
  using namespace IPConfigComposite::TraceDetail;
  static Buffer messageBuffer;
  switch (type) {
    case EntryMessage:
      write(messageBuffer, "ENTERING: ", text, "() in ", file, " [Line: ", Number(line), "]");
      break;
    case ExitMessage:
      write(messageBuffer, "EXITING: ", text, "() in ", file, " [Line: ", Number(line), "]");
      break;
    case MethodInvokedMessage:
      write(messageBuffer, "METHOD: ", text, "() was invoked in ", file, " [Line: ", Number(line), "]");
      break;
    case FreeMessage:
      write(messageBuffer, "MESSAGE [File: ", file, ", Line: ", Number(line), "]: ", text);
      break;
    default:
      write(messageBuffer, "");
  }
  return messageBuffer;
}

// The same of C strings; a null counts as empty.
inline char* trace(const char* file, const char* text, unsigned int line, MessageType type) {
  using IPConfigComposite::TraceDetail::viewOf;
  return trace(viewOf(file), viewOf(text), line, type);
}

// Formats a line about a variable. The result is valid until the next call of this overload anywhere in the library.
inline char* trace(std::string_view name, std::string_view file, unsigned int line, std::string_view value) {
  using namespace IPConfigComposite::TraceDetail;
  static Buffer messageBuffer;
  write(messageBuffer, "VARIABLE: '", name, "' has Value '", value, "' at line ", Number(line), " in ", file);
  return messageBuffer;
}

inline char* trace(const char* name, const char* file, unsigned int line, const char* value) {
  using IPConfigComposite::TraceDetail::viewOf;
  return trace(viewOf(name), viewOf(file), line, viewOf(value));
}

namespace IPConfigComposite {

// Levels of the agent's log: progress, and failures that the library noticed.
inline constexpr int progressLevel = 4000;
inline constexpr int failureLevel = 6000;

namespace TraceDetail {

// Sends a line to the log, then to the trace. It is formatted anew for the second channel: the shared buffer may have
// been used in between.
template <typename Format>
void send(const std::string& component, int level, const char* function, const char* file, unsigned int line,
          Format format) {
  TWLog::TWMessageBuffer buffer;
  const int lineNumber = static_cast<int>(line);
  buffer << format();
  TWLog::TWLogger::logLevelMessage(function, file, lineNumber, component, level, nullptr, 0, 0, TWLog::str(buffer));
  buffer << format();
  TWLog::TWLogger::traceLevelMessage(function, file, lineNumber, component, level, nullptr, 0, 0, TWLog::str(buffer));
}

constexpr const char* rule = "==============================================================================";
static_assert(std::char_traits<char>::length(rule) == 78);

constexpr const char* frameFile = "Trace.h";

}  // namespace TraceDetail

}  // namespace IPConfigComposite

// Opens the frame of a provider operation: the rule, then the operation's ENTERING line. The text names the operation;
// the location that the logger sees is the frame's own, at fixed lines (compatibility 3).
inline void markProviderEntry(const std::string& component, const char* file, const char* function, unsigned int line) {
  using namespace IPConfigComposite;
  TraceDetail::send(component, progressLevel, "markProviderEntry", TraceDetail::frameFile, 336,
                    [] { return TraceDetail::rule; });
  TraceDetail::send(component, progressLevel, "markProviderEntry", TraceDetail::frameFile, 337,
                    [=] { return trace(file, function, line, EntryMessage); });
}

// Closes the frame: the operation's EXITING line, then the rule.
inline void markProviderExit(const std::string& component, const char* file, const char* function, unsigned int line) {
  using namespace IPConfigComposite;
  TraceDetail::send(component, progressLevel, "markProviderExit", TraceDetail::frameFile, 348,
                    [=] { return trace(file, function, line, ExitMessage); });
  TraceDetail::send(component, progressLevel, "markProviderExit", TraceDetail::frameFile, 349,
                    [] { return TraceDetail::rule; });
}

namespace IPConfigComposite {

// What one function reports under: its unit's component and source file and its own name. The component must outlive
// the frame, and so must the texts, each of which ends with a null. A line's number is the caller's unless given;
// numbers that are given are fixed (compatibility 3).
class Frame {
 public:
  Frame(const std::string& component, std::string_view file, std::string_view function)
      : component_(component), file_(file), function_(function) {}

  void markEntry(unsigned int line = __builtin_LINE()) const {
    markProviderEntry(component_, file_.data(), function_.data(), line);
  }
  void markExit(unsigned int line = __builtin_LINE()) const {
    markProviderExit(component_, file_.data(), function_.data(), line);
  }

  void entering(unsigned int line = __builtin_LINE()) const { message(function_, line, EntryMessage, progressLevel); }
  void exiting(unsigned int line = __builtin_LINE()) const { message(function_, line, ExitMessage, progressLevel); }

  void progress(std::string_view text, unsigned int line = __builtin_LINE()) const {
    message(text, line, FreeMessage, progressLevel);
  }
  void failure(std::string_view text, unsigned int line = __builtin_LINE()) const {
    message(text, line, FreeMessage, failureLevel);
  }

  void variable(std::string_view name, std::string_view value, unsigned int line = __builtin_LINE()) const {
    TraceDetail::send(component_, progressLevel, function_.data(), file_.data(), line,
                      [&] { return trace(name, file_, line, value); });
  }

 private:
  void message(std::string_view text, unsigned int line, MessageType type, int level) const {
    TraceDetail::send(component_, level, function_.data(), file_.data(), line,
                      [&] { return trace(file_, text, line, type); });
  }

  const std::string& component_;
  std::string_view file_;
  std::string_view function_;
};

}  // namespace IPConfigComposite

}  // namespace QV
