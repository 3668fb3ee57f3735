#include "cimom/configuration/IniFile.h"

#include <ini.h>

#include <algorithm>
#include <stdexcept>

namespace Cimom {
namespace {

// One pass of inih over a text. Its frames are C, which no exception may pass, and it goes on after an error: what was
// thrown first is kept as text.
struct Pass {
  std::istream& text;
  const std::function<void(const IniEntry&)>& take;
  unsigned line = 0;
  std::string error = {};
  unsigned errorLine = 0;

  void refuse(const std::string& what) {
    if (error.empty()) {
      error = what;
      errorLine = line;
    }
  }
};

// Hands inih a line; null ends the reading.
char* nextLine(char* buffer, int size, void* handle) {
  auto& pass = *static_cast<Pass*>(handle);
  std::string line;
  if (!pass.error.empty() || !std::getline(pass.text, line)) {
    return nullptr;
  }
  ++pass.line;
  // inih takes an indented line for one more value of the key above it.
  line.erase(0, std::min(line.find_first_not_of(" \t\r\f\v"), line.size()));
  // It takes what its buffer cannot hold for a line of its own.
  const auto room = static_cast<std::size_t>(size) - 1;
  if (line.size() > room) {
    pass.refuse("the line is longer than " + std::to_string(room) + " characters");
    return nullptr;
  }
  if (line.find('\0') != std::string::npos) {
    pass.refuse("the line contains a null character");
    return nullptr;
  }
  std::copy_n(line.c_str(), line.size() + 1, buffer);
  return buffer;
}

int takeEntry(void* handle, const char* section, const char* key, const char* value) {
  auto& pass = *static_cast<Pass*>(handle);
  try {
    pass.take({section, key, value, pass.line});
    return 1;
  } catch (const std::exception& error) {
    pass.refuse(error.what());
    return 0;
  }
}

}  // namespace

void readIni(std::istream& text, const std::string& fileName, const std::function<void(const IniEntry&)>& take) {
  Pass pass{text, take};
  const int badLine = ini_parse_stream(&nextLine, &pass, &takeEntry, &pass);
  if (badLine > 0 && (pass.error.empty() || static_cast<unsigned>(badLine) < pass.errorLine)) {
    pass.error = "expected \"key = value\"";
    pass.errorLine = static_cast<unsigned>(badLine);
  }
  if (!pass.error.empty()) {
    throw std::runtime_error(fileName + ":" + std::to_string(pass.errorLine) + ": " + pass.error);
  }
  if (badLine < 0) {
    throw std::runtime_error(fileName + ": cannot be read");
  }
}

}  // namespace Cimom
