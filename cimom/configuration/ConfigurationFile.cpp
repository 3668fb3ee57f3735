#include "cimom/configuration/ConfigurationFile.h"

#include <ini.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <optional>
#include <string>

namespace Cimom {
namespace {

struct Reading {
  std::filesystem::path file;
  std::ifstream stream;
  unsigned line = 0;
  GivenValues values;
  std::optional<std::string> error;  // the first; C code between forbids to throw it

  int refuse(const std::string& what) {
    if (!error) {
      error = file.string() + ":" + std::to_string(line) + ": " + what;
    }
    return 0;
  }
};

// Hands inih a line. It takes the rest of a line that its buffer cannot hold for a line of its own, so such a line ends
// the reading.
char* nextLine(char* buffer, int size, void* handle) {
  auto& reading = *static_cast<Reading*>(handle);
  std::string text;
  if (reading.error || !std::getline(reading.stream, text)) {
    return nullptr;
  }
  ++reading.line;
  const auto room = static_cast<std::size_t>(size) - 1;
  if (text.size() > room) {
    reading.refuse("the line is longer than " + std::to_string(room) + " characters");
    return nullptr;
  }
  std::copy_n(text.c_str(), text.size() + 1, buffer);
  return buffer;
}

int takeValue(void* handle, const char* section, const char* name, const char* value) {
  auto& reading = *static_cast<Reading*>(handle);
  if (*section != '\0') {
    return reading.refuse("there is no section [" + std::string(section) + "]");
  }
  if (!findSetting(name)) {
    return reading.refuse("unknown key \"" + std::string(name) + "\"");
  }
  const std::string origin = reading.file.string() + ":" + std::to_string(reading.line) + ": " + name;
  reading.values[name].push_back({value, origin, reading.file.parent_path()});
  return 1;
}

}  // namespace

GivenValues readConfigurationFile(const std::filesystem::path& file) {
  Reading reading{file, std::ifstream(file), 0, {}, {}};
  if (!reading.stream || std::filesystem::is_directory(file)) {
    throw UsageError(file.string() + ": " + (reading.stream ? "is a directory" : std::strerror(errno)));
  }
  const int errorLine = ini_parse_stream(&nextLine, &reading, &takeValue, &reading);
  if (reading.error) {
    throw UsageError(*reading.error);
  }
  if (errorLine > 0) {
    throw UsageError(file.string() + ":" + std::to_string(errorLine) + ": is no \"key = value\"");
  }
  return std::move(reading.values);
}

}  // namespace Cimom
