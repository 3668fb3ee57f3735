#include "cimom/configuration/CommandLine.h"

#include <CLI/CLI.hpp>
#include <iostream>

#include "cimom/configuration/ConfigurationFile.h"

namespace Cimom {

std::optional<Configuration> readCommandLine(int argc, const char* const* argv) {
  CLI::App app("A CIM object manager for CMPI 2.0 providers: serves CIM-XML over HTTP.", "cimomd");
  app.set_version_flag("--version", "cimomd " CIMOMD_VERSION);
  std::string file;
  app.add_option("--config", file, "configuration file: the options below as \"key = value\" lines")->type_name("FILE");
  std::map<std::string, std::vector<std::string>> texts;
  for (const Setting& setting : settings()) {
    app.add_option("--" + std::string(setting.name), texts[setting.name], setting.help)
        ->type_name(setting.valueName)
        ->allow_extra_args(setting.repeatable);
  }
  try {
    app.parse(argc, argv);
  } catch (const CLI::Success& asked) {
    app.exit(asked);
    return std::nullopt;
  } catch (const CLI::ParseError& error) {
    throw UsageError(error.what());
  }
  GivenValues values;
  if (!file.empty()) {
    values = readConfigurationFile(file);
  }
  for (const auto& [name, given] : texts) {
    if (given.empty()) {
      continue;
    }
    auto& taken = values[name];
    taken.clear();
    for (const std::string& text : given) {
      taken.push_back({text, "--" + name, {}});
    }
  }
  return toConfiguration(values);
}

}  // namespace Cimom
