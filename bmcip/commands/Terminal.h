// SPDX-License-Identifier: Apache-2.0
// The person at the terminal, if there is one.
#pragma once

#include <cstddef>
#include <string>

namespace Bmcip {

// Asks at the terminal, whatever the standard streams are, without showing what is typed. Throws UsageError if there is
// no terminal.
std::string askPassword(const std::string& user);

// Whether the answer to the question is yes; no where the standard input is no terminal.
bool isConfirmed(const std::string& question);

// How far a fleet has come, on the standard error; nothing where that is no terminal.
class Progress {
 public:
  explicit Progress(std::size_t total);
  ~Progress() { clear(); }
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;

  void show(std::size_t done, std::size_t failed);
  void clear();

 private:
  const std::size_t total_;
  const bool isShown_;
  std::string last_;
};

}  // namespace Bmcip
