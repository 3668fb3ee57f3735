// SPDX-License-Identifier: Apache-2.0
// Programs that tests run beside themselves.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include "ground/Descriptor.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

using Environment = std::map<std::string, std::string>;

// A program that runs beside the test and is killed at the latest with this object.
class Process {
 public:
  // @param command the program, looked for along PATH, and its arguments
  // @param environment added to the test's own
  explicit Process(const std::vector<std::string>& command, const Environment& environment = {});
  ~Process();
  Process(const Process&) = delete;
  Process& operator=(const Process&) = delete;

  pid_t id() const { return id_; }

  void signal(int number) const;
  // To it and its process group, as a terminal does at ^C. The program must lead one: begin its command with setsid.
  void signalGroup(int number) const;

  // The exit status; 128 and the signal's number if a signal ended it. Throws std::runtime_error when the program has
  // not ended by then.
  int wait(std::chrono::seconds patience = std::chrono::seconds(100));
  bool isRunning();

  // Hands it a line on its standard input, which is open until closeInput().
  void writeLine(const std::string& line) const;
  void closeInput();

  // The next line of its output, without the line feed; empty if it ends before.
  std::string readLine();

  // What it has written so far.
  std::string output() const;
  std::string errors() const;

 private:
  TemporaryDirectory directory_;
  std::string name_;
  pid_t id_ = -1;
  int status_ = -1;
  Ground::Descriptor input_;
  std::size_t read_ = 0;  // how much of the output readLine() has returned
};

// A program that has run to its end.
struct Completed {
  int status;
  std::string output;
  std::string errors;
};

// Runs a program that is given nothing on its standard input.
Completed run(const std::vector<std::string>& command, const Environment& environment = {},
              std::chrono::seconds patience = std::chrono::seconds(100));

}  // namespace Testing
