// SPDX-License-Identifier: Apache-2.0
// The lines of log and trace.
#pragma once

#include <string>

namespace Testing::Model {

// Levels.
inline constexpr int ordinary = 4000;
inline constexpr int failure = 6000;

// What one function reports under. A line's number is any where it is 0.
struct Report {
  std::string component;
  std::string file;
  std::string function;

  void entering(int line = 0) const;
  void exiting(int line = 0) const;
  void message(const std::string& text, int level = ordinary, int line = 0) const;
  void variable(const char* name, const std::string& value, int line = 0) const;
  // Around a provider's operation: with the rule before and after.
  void operationEntry(int line = 0) const;
  void operationExit(int line = 0) const;

 private:
  std::string place(int line) const;
};

// Of a member of the factory.
Report memberReport(const char* function);

}  // namespace Testing::Model
