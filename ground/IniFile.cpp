// SPDX-License-Identifier: Apache-2.0
#include "ground/IniFile.h"

#include <ini.h>

#include <algorithm>
#include <stdexcept>
#include <vector>

namespace Ground {
namespace {

// One pass of inih over a text. It reports no line numbers to its handler and goes on after a line that is not INI: the
// lines are counted as they are handed to it, and the entries are kept until the first bad line is known.
struct Pass {
  std::istream& text;
  unsigned line = 0;
  std::vector<IniEntry> entries = {};
  std::string fault = {};  // why the reading stopped at `line`
};

// Hands inih a line; null ends the reading.
char* nextLine(char* buffer, int size, void* handle) {
  auto& pass = *static_cast<Pass*>(handle);
  std::string line;
  if (!pass.fault.empty() || !std::getline(pass.text, line)) {
    return nullptr;
  }
  ++pass.line;
  // inih takes an indented line for one more value of the key above it.
  line.erase(0, std::min(line.find_first_not_of(" \t\r\f\v"), line.size()));
  // It takes what its buffer cannot hold for a line of its own.
  const auto room = static_cast<std::size_t>(size) - 2;
  if (line.size() > room) {
    pass.fault = "the line is longer than " + std::to_string(room) + " characters";
    return nullptr;
  }
  if (line.find('\0') != std::string::npos) {
    pass.fault = "the line contains a null character";
    return nullptr;
  }
  std::copy_n(line.c_str(), line.size() + 1, buffer);
  return buffer;
}

int keepEntry(void* handle, const char* section, const char* key, const char* value) {
  auto& pass = *static_cast<Pass*>(handle);
  pass.entries.push_back({section, key, value, pass.line});
  return 1;
}

[[noreturn]] void fail(const std::string& fileName, unsigned line, const std::string& what) {
  throw std::runtime_error(fileName + ":" + std::to_string(line) + ": " + what);
}

}  // namespace

void readIni(std::istream& text, const std::string& fileName, const std::function<void(const IniEntry&)>& take) {
  Pass pass{text};
  const int result = ini_parse_stream(&nextLine, &pass, &keepEntry, &pass);
  const auto badLine = static_cast<unsigned>(std::max(result, 0));
  for (const IniEntry& entry : pass.entries) {
    if (badLine != 0 && entry.line > badLine) {
      break;
    }
    try {
      take(entry);
    } catch (const std::exception& error) {
      fail(fileName, entry.line, error.what());
    }
  }
  if (badLine != 0) {
    fail(fileName, badLine, "must be a [section] or a key = value");
  }
  if (!pass.fault.empty()) {
    fail(fileName, pass.line, pass.fault);
  }
  if (result < 0 || text.bad()) {
    throw std::runtime_error(fileName + ": cannot be read");
  }
}

}  // namespace Ground
