#pragma once

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/configuration/Configuration.h"

namespace Cimom {

// A value as it was given.
struct GivenValue {
  std::string text;
  std::string origin;          // for messages: "--port", "cimomd.ini:12: port"
  std::filesystem::path base;  // what a relative path is relative to; empty: the working directory
};

// The values given for each setting, by its name.
using GivenValues = std::map<std::string, std::vector<GivenValue>, std::less<>>;

// One thing that can be configured: an option of the command line, and under the same name a key of the file.
struct Setting {
  const char* name;
  const char* valueName;  // what help calls the value
  const char* help;
  bool repeatable;
  std::function<void(Configuration&, const GivenValue&)> apply;  // throws UsageError for a bad value
};

// All settings, in the order of the help.
const std::vector<Setting>& settings();

// The setting of that name, or null.
const Setting* findSetting(std::string_view name);

// Throws UsageError for a value that is bad, or given twice where one is wanted, and for values that do not go
// together.
Configuration toConfiguration(const GivenValues& values);

}  // namespace Cimom
