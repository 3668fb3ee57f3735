// SPDX-License-Identifier: Apache-2.0
#include "bmcip/commands/Configuration.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>

#include "ground/FileContent.h"
#include "ground/IniFile.h"

namespace Bmcip {
namespace {

namespace fs = std::filesystem;

std::chrono::milliseconds parseTimeout(const std::string& value) {
  return Ground::parseSeconds(value, std::chrono::milliseconds(10), std::chrono::hours(1));
}

std::string readable(const std::string& value) {
  if (!std::ifstream(value).good() || fs::is_directory(value)) {
    throw std::invalid_argument(
        value + " cannot be read: " + (fs::is_directory(value) ? "it is a directory" : std::strerror(errno)));
  }
  return value;
}

// "user:password", on the one line of the file.
void readCredentials(Options& options, const std::string& path) {
  const std::string text = Ground::readSecretFile(path);
  const auto end = text.find('\n');
  const std::string line = text.substr(0, end);
  const auto colon = line.find(':');
  if (colon == std::string::npos || colon == 0 || (end != std::string::npos && end + 1 != text.size())) {
    throw std::invalid_argument(path + " must be one line, USER:PASSWORD");
  }
  options.access.user = line.substr(0, colon);
  options.access.password = line.substr(colon + 1);
}

void apply(Options& options, const Setting& setting, const std::string& value, const std::string& origin) {
  try {
    setting.apply(options, value);
  } catch (const std::exception& refusal) {
    throw UsageError(origin + ": " + refusal.what());
  }
}

const Setting* findSetting(const std::string& name) {
  for (const Setting& setting : settings()) {
    if (name == setting.name) {
      return &setting;
    }
  }
  return nullptr;
}

void readFile(Options& options, const fs::path& path) {
  std::ifstream stream(path);
  if (!stream || fs::is_directory(path)) {
    throw UsageError(path.string() + ": " + (stream ? "is a directory" : std::strerror(errno)));
  }
  const auto take = [&](const Ground::IniEntry& entry) {
    const Setting* setting = entry.section.empty() ? findSetting(entry.key) : nullptr;
    if (!setting) {
      throw std::invalid_argument("unknown key \"" + entry.key + "\"" +
                                  (entry.section.empty() ? "" : " in [" + entry.section + "]: there are no sections") +
                                  "; bmcip(1) has the keys");
    }
    try {
      setting->apply(options, entry.value);
    } catch (const std::invalid_argument& refusal) {
      throw std::invalid_argument(entry.key + ": " + refusal.what());
    }
  };
  try {
    Ground::readIni(stream, path.string(), take);
  } catch (const std::runtime_error& error) {
    throw UsageError(error.what());
  }
}

// The file that is read where none is named; empty: none.
fs::path usualFile() {
  const char* configuration = std::getenv("XDG_CONFIG_HOME");
  const char* home = std::getenv("HOME");
  std::error_code unreadable;
  fs::path own;
  if (configuration && *configuration) {
    own = fs::path(configuration) / "bmcip.ini";
  } else if (home && *home) {
    own = fs::path(home) / ".config" / "bmcip.ini";
  }
  for (const fs::path& path : {own, fs::path(systemConfigurationFile())}) {
    if (!path.empty() && fs::exists(path, unreadable)) {
      return path;
    }
  }
  return {};
}

}  // namespace

const std::vector<Setting>& settings() {
  static const std::vector<Setting> table = {
      {"url", "URL", "the object manager to ask (http://localhost:5988); BMCIP_URL says the same", false,
       [](Options& options, const std::string& value) { options.server = parseServer(value); }},
      {"cacert", "FILE", "PEM file with the authority that signed the servers' certificates (the system's)", false,
       [](Options& options, const std::string& value) { options.access.cacert = readable(value); }},
      {"credentials", "FILE", "log in with the line USER:PASSWORD of this file, whose mode must be 600", false,
       [](Options& options, const std::string& value) { readCredentials(options, value); }},
      {"netrc", "", "log in with what ~/.netrc has for the host", true,
       [](Options& options, const std::string& value) {
         options.access.netrc = Ground::parseBoolean(value);
         const char* home = std::getenv("HOME");
         if (options.access.netrc) {
           Ground::requireSecretFile(std::string(home ? home : "") + "/.netrc");
         }
       }},
      {"connect-timeout", "SECONDS", "give a server up that takes no connection in that time (5)", false,
       [](Options& options, const std::string& value) { options.access.connectTimeout = parseTimeout(value); }},
      {"timeout", "SECONDS", "give a request up that is not answered in that time (30)", false,
       [](Options& options, const std::string& value) { options.access.timeout = parseTimeout(value); }},
      {"parallel", "N", "how many servers are asked at once (256)", false,
       [](Options& options, const std::string& value) {
         options.parallel = static_cast<std::size_t>(Ground::parseNumber(value, 1, 10000));
       }},
  };
  return table;
}

std::string systemConfigurationFile() { return CONFIGURATION_DIR "/bmcip.ini"; }

void applySettings(Options& options, const GivenSettings& given, const std::string& configurationFile) {
  const fs::path file = configurationFile.empty() ? usualFile() : fs::path(configurationFile);
  if (!file.empty()) {
    readFile(options, file);
  }
  if (const char* url = std::getenv("BMCIP_URL"); url && *url) {
    apply(options, *findSetting("url"), url, "BMCIP_URL");
  }
  for (const auto& [name, value] : given) {
    if (!value.empty()) {
      apply(options, *findSetting(name), value, "--" + name);
    }
  }
}

}  // namespace Bmcip
