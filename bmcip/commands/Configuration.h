// SPDX-License-Identifier: Apache-2.0
// What can be configured: each an option, and under the same name a key of the configuration file.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "bmcip/commands/Options.h"
#include "ground/Values.h"

namespace Bmcip {

struct Setting {
  const char* name;
  const char* valueName;
  const char* help;
  bool isSwitch;
  void (*apply)(Options& options, const std::string& value);  // throws std::invalid_argument
};

const std::vector<Setting>& settings();

// The values given for settings by the command line, by their names; empty: none.
using GivenSettings = std::map<std::string, std::string>;

std::string systemConfigurationFile();

// The command line goes before BMCIP_URL, and that before the file: the one that is named, which must be there, else
// the user's own, else the system's. Throws UsageError naming file and line, or the option.
void applySettings(Options& options, const GivenSettings& given, const std::string& configurationFile);

}  // namespace Bmcip
