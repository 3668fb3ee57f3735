// SPDX-License-Identifier: Apache-2.0
#include "cimom/configuration/Configuration.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <functional>
#include <limits>
#include <map>
#include <string_view>
#include <system_error>
#include <utility>

#include "ground/IniFile.h"
#include "ground/Values.h"

namespace Cimom {
namespace {

// The port that IANA has for CIM-XML over TLS.
constexpr std::uint16_t wbemHttps = 5989;

// A value as it was given.
struct GivenValue {
  std::string text;
  std::string origin;          // for messages: "--port", "cimomd.ini:12: port"
  std::filesystem::path base;  // what a relative path is relative to; empty: the working directory
};

// The values given for each setting, by its name.
using GivenValues = std::map<std::string, std::vector<GivenValue>, std::less<>>;

using Apply = std::function<void(Configuration&, const GivenValue&)>;

// One thing that can be configured: an option of the command line, and under the same name a key of the file.
struct Setting {
  const char* name;
  const char* valueName;  // what help calls the value
  const char* help;
  bool repeatable;
  Apply apply;  // throws UsageError for a bad value
};

// What the parser makes of the value's text; its refusal names the value.
template <typename Parser, typename... Range>
auto parse(const GivenValue& value, Parser parser, Range... range) {
  try {
    return parser(value.text, range...);
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(value.origin + ": " + refusal.what() + ", not \"" + value.text + "\"");
  }
}

std::filesystem::path parsePath(const GivenValue& value) {
  if (value.text.empty()) {
    throw UsageError(value.origin + ": must not be empty");
  }
  return value.base / value.text;
}

template <typename Number>
Apply number(Number Configuration::*member, std::uint64_t least, std::uint64_t most) {
  return [=](Configuration& configuration, const GivenValue& value) {
    configuration.*member = Number(parse(value, Ground::parseNumber, least, most));
  };
}

Apply path(std::filesystem::path Configuration::*member) {
  return [=](Configuration& configuration, const GivenValue& value) { configuration.*member = parsePath(value); };
}

Apply paths(std::vector<std::filesystem::path> Configuration::*member) {
  return [=](Configuration& configuration, const GivenValue& value) {
    (configuration.*member).push_back(parsePath(value));
  };
}

void strictness(Configuration& configuration, const GivenValue& value) {
  if (value.text != "exact" && value.text != "bare") {
    throw UsageError(value.origin + ": must be exact or bare, not \"" + value.text + "\"");
  }
  configuration.bare = value.text == "bare";
}

// In the order of the help.
const std::vector<Setting>& settings() {
  constexpr std::uint64_t day = 86400;
  static const std::vector<Setting> table = {
      {"address", "ADDRESS", "numeric address to listen on (127.0.0.1)", false,
       [](Configuration& configuration, const GivenValue& value) { configuration.address = value.text; }},
      {"port", "N", "port to listen on; 0: any free port (5988, with TLS 5989)", false,
       number(&Configuration::port, 0, 65535)},
      {"schema", "PATH", "MOF file, or directory of *.mof files, with the classes", true,
       paths(&Configuration::schemas)},
      {"registration", "PATH", "file, or directory of *.reg files: which provider serves which class", true,
       paths(&Configuration::registrations)},
      {"provider-dir", "DIR", "directory with the providers' libraries", true,
       paths(&Configuration::providerDirectories)},
      {"max-request-size", "BYTES", "largest body of a request (4194304)", false,
       number(&Configuration::maxRequestSize, 1024, std::numeric_limits<std::int32_t>::max())},
      {"max-request-memory", "BYTES", "bodies of all requests in progress together (33554432)", false,
       number(&Configuration::maxRequestMemory, 1024, std::numeric_limits<std::int32_t>::max())},
      {"max-requests", "N", "requests answered at once (64)", false, number(&Configuration::maxRequests, 1, 4096)},
      {"max-connections", "N", "connections open at once (512)", false,
       number(&Configuration::maxConnections, 1, 4096)},
      {"max-connections-per-address", "N", "of them from one address (64)", false,
       number(&Configuration::maxConnectionsPerAddress, 1, 4096)},
      {"request-timeout", "SECONDS", "receive a whole request within this time (30)", false,
       number(&Configuration::requestTimeout, 1, day)},
      {"operation-timeout", "SECONDS", "answer a request whose provider has not within this time (60)", false,
       number(&Configuration::operationTimeout, 1, day)},
      {"idle-timeout", "SECONDS", "close a connection after so long without traffic (60)", false,
       number(&Configuration::idleTimeout, 1, day)},
      {"shutdown-timeout", "SECONDS", "wait so long for requests in progress when shutting down (20)", false,
       number(&Configuration::shutdownTimeout, 0, day)},
      {"strictness", "MODE",
       "exact: check requests as DSP0200 asks; bare: leave that to the providers, as others do (exact)", false,
       strictness},
      {"server-name", "NAME", "a further host name that clients may ask this server by", true,
       [](Configuration& configuration, const GivenValue& value) {
         configuration.serverNames.push_back(parse(value, Ground::parseText));
       }},
      {"tls-certificate", "FILE", "PEM file with the certificate chain; with tls-key: HTTPS instead of HTTP", false,
       path(&Configuration::tlsCertificate)},
      {"tls-key", "FILE", "PEM file with the certificate's private key", false, path(&Configuration::tlsKey)},
      {"password-file", "FILE", "user:hash lines (crypt(5)); only these users are served", false,
       path(&Configuration::passwordFile)},
      {"request-log", "FILE", "a line for each request; -: to the standard output", false,
       [](Configuration& configuration, const GivenValue& value) {
         configuration.requestLog = value.text == "-" ? std::filesystem::path("-") : parsePath(value);
       }},
      {"trace", "YES|NO", "what providers trace, to the standard error output (no)", false,
       [](Configuration& configuration, const GivenValue& value) {
         configuration.trace = parse(value, Ground::parseBoolean);
       }},
      {"user", "NAME", "the user to become, where root starts it", false,
       [](Configuration& configuration, const GivenValue& value) {
         configuration.user = parse(value, Ground::parseText);
       }}};
  return table;
}

bool isSetting(std::string_view name) {
  return std::ranges::any_of(settings(), [name](const Setting& setting) { return setting.name == name; });
}

GivenValues readConfigurationFile(const std::filesystem::path& file) {
  std::ifstream stream(file);
  if (!stream || std::filesystem::is_directory(file)) {
    throw UsageError(file.string() + ": " + (stream ? "is a directory" : std::strerror(errno)));
  }
  GivenValues values;
  const auto take = [&](const Ground::IniEntry& entry) {
    if (!entry.section.empty()) {
      throw UsageError("there are no sections in this file, but \"" + entry.key + "\" is in [" + entry.section + "]");
    }
    if (!isSetting(entry.key)) {
      throw UsageError("unknown key \"" + entry.key + "\"");
    }
    const std::string origin = file.string() + ":" + std::to_string(entry.line) + ": " + entry.key;
    values[entry.key].push_back({entry.value, origin, file.parent_path()});
  };
  try {
    Ground::readIni(stream, file.string(), take);
  } catch (const std::runtime_error& error) {
    throw UsageError(error.what());
  }
  return values;
}

void useInstalled(std::vector<std::filesystem::path>& paths, const char* setting,
                  const std::filesystem::path& installed) {
  if (!paths.empty()) {
    return;
  }
  std::error_code unreadable;
  if (!std::filesystem::exists(installed, unreadable)) {
    throw UsageError(std::string("--") + setting + ": must be given, because " + installed.string() +
                     ", where it is installed, cannot be read or does not exist");
  }
  paths.push_back(installed);
}

Configuration toConfiguration(const GivenValues& given, const Installation& installation) {
  Configuration configuration;
  for (const Setting& setting : settings()) {
    const auto values = given.find(std::string_view(setting.name));
    if (values == given.end()) {
      continue;
    }
    if (!setting.repeatable && values->second.size() > 1) {
      throw UsageError(values->second[1].origin + ": duplicate");
    }
    for (const GivenValue& value : values->second) {
      setting.apply(configuration, value);
    }
  }
  if (configuration.tlsCertificate.empty() != configuration.tlsKey.empty()) {
    throw UsageError("tls-certificate and tls-key must be given together");
  }
  if (!given.contains("port") && !configuration.tlsCertificate.empty()) {
    configuration.port = wbemHttps;
  }
  useInstalled(configuration.schemas, "schema", installation.schema);
  useInstalled(configuration.registrations, "registration", installation.registration);
  useInstalled(configuration.providerDirectories, "provider-dir", installation.providerDirectory);
  return configuration;
}

}  // namespace

Configuration readConfiguration(const std::filesystem::path& file, const Installation& installation) {
  return toConfiguration(readConfigurationFile(file), installation);
}

std::optional<Configuration> readCommandLine(int argc, const char* const* argv, const Installation& installation) {
  CLI::App app("A CIM object manager for CMPI 2.0 providers: serves CIM-XML over HTTP.", "cimomd");
  app.set_version_flag("--version", "cimomd " CIMOMD_VERSION);
  std::string file;
  const std::string installedFile = installation.configurationFile.string();
  const CLI::Option* fileOption =
      app.add_option("--config", file,
                     "configuration file: the options below as \"key = value\" lines (" + installedFile + ")")
          ->type_name("FILE");
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
  std::error_code unreadable;
  if (!fileOption->empty()) {
    if (file.empty()) {
      throw UsageError("--config: must not be empty");
    }
    values = readConfigurationFile(file);
  } else if (std::filesystem::status(installation.configurationFile, unreadable).type() !=
             std::filesystem::file_type::not_found) {
    values = readConfigurationFile(installation.configurationFile);
  } else if (argc < 2) {
    throw UsageError("nothing to serve: write " + installedFile +
                     " (cimomd.ini.sample shows every key), name another file with --config, or give options (--help)");
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
  return toConfiguration(values, installation);
}

}  // namespace Cimom
