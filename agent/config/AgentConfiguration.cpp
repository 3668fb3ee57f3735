#include "agent/config/AgentConfiguration.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <exception>
#include <fstream>
#include <iterator>
#include <limits>
#include <set>
#include <stdexcept>
#include <utility>
#include <vector>

#include "ground/IniFile.h"
#include "ground/Values.h"

namespace QV {
namespace {

using Destination = ChannelSettings::Destination;

int level(const std::string& value) {
  return static_cast<int>(Ground::parseNumber(value, 0, std::numeric_limits<int>::max()));
}

Destination destination(const std::string& value) {
  return Ground::parseChoice<Destination>(value, {{"off", Destination::Off},
                                                  {"syslog", Destination::Syslog},
                                                  {"stderr", Destination::Stderr},
                                                  {"file", Destination::File}});
}

// The name becomes part of a library's: it must not lead to another folder.
std::string backEnd(const std::string& value) {
  const bool plain = std::ranges::all_of(value, [](char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           (character >= '0' && character <= '9') || character == '-';
  });
  if (value.empty() || !plain) {
    throw std::invalid_argument("must be the name of a back end, of letters, digits and '-'");
  }
  return value;
}

constexpr const char* componentThreshold = "threshold.";

struct Key {
  const char* section;
  const char* name;  // a name that ends in '.' takes any key that starts so
  void (*set)(AgentConfiguration& configuration, const std::string& key, const std::string& value);
};

using Configuration = AgentConfiguration;
using Text = const std::string;

const Key keys[] = {
    {"system", "name", [](Configuration& c, Text&, Text& value) { c.systemName = Ground::parseText(value); }},
    {"log", "destination", [](Configuration& c, Text&, Text& value) { c.log.destination = destination(value); }},
    {"log", "file", [](Configuration& c, Text&, Text& value) { c.log.file = Ground::parseAbsolutePath(value); }},
    {"log", "threshold", [](Configuration& c, Text&, Text& value) { c.log.threshold = level(value); }},
    {"log", componentThreshold,
     [](Configuration& c, Text& key, Text& value) {
       c.log.componentThresholds[key.substr(std::strlen(componentThreshold))] = level(value);
     }},
    {"trace", "destination", [](Configuration& c, Text&, Text& value) { c.trace.destination = destination(value); }},
    {"trace", "file", [](Configuration& c, Text&, Text& value) { c.trace.file = Ground::parseAbsolutePath(value); }},
    {"trace", "threshold", [](Configuration& c, Text&, Text& value) { c.trace.threshold = level(value); }},
    {"trace", componentThreshold,
     [](Configuration& c, Text& key, Text& value) {
       c.trace.componentThresholds[key.substr(std::strlen(componentThreshold))] = level(value);
     }},
    {"host", "publish", [](Configuration& c, Text&, Text& value) { c.publishesHost = Ground::parseBoolean(value); }},
    {"processor", "backend", [](Configuration& c, Text&, Text& value) { c.backEnd = backEnd(value); }},
    {"processor", "name", [](Configuration& c, Text&, Text& value) { c.processorName = Ground::parseText(value); }},
    {"processor", "description",
     [](Configuration& c, Text&, Text& value) { c.processorDescription = Ground::parseText(value); }},
};

// What stands in the file's stead in the message that it is missing, or cannot be read.
std::string remedyFor(int error) {
  if (error == ENOENT || error == ENOTDIR) {
    return "create it and choose the management processor there: [processor] with backend = ipmi for a BMC, or "
           "backend = simulated for made-up values";
  }
  return "let the object manager's user read it";
}

// "file, threshold, threshold.COMPONENT": the keys of a section, for the message that one is none of them.
std::string keysOf(const std::string& section) {
  std::string names;
  for (const Key& known : keys) {
    if (section == known.section) {
      const std::string name = known.name;
      names += (names.empty() ? "" : ", ") + name + (name.ends_with('.') ? "COMPONENT" : "");
    }
  }
  return names;
}

bool takes(const Key& known, const std::string& key) {
  const std::string name = known.name;
  return name.ends_with('.') ? key.starts_with(name) && key.size() > name.size() : key == name;
}

const char* const backEnds[] = {AGENT_BACK_ENDS};

// The section of a back end that is not chosen may stay: an administrator who tries another would lose it.
bool isBackEndSection(const std::string& section, const std::string& chosen) {
  return section == chosen || std::ranges::find(backEnds, section) != std::end(backEnds);
}

std::string chosenBackEnd(const std::vector<Ground::IniEntry>& entries) {
  for (const Ground::IniEntry& entry : entries) {
    if (entry.section == "processor" && entry.key == "backend") {
      return entry.value;
    }
  }
  return {};
}

std::string knownSections() {
  std::vector<std::string> names;
  for (const Key& known : keys) {
    names.emplace_back(known.section);
  }
  names.insert(names.end(), std::begin(backEnds), std::end(backEnds));
  names.erase(std::unique(names.begin(), names.end()), names.end());
  return Ground::mustBeOneOf(names);
}

void set(AgentConfiguration& configuration, const Ground::IniEntry& entry, const std::string& chosen) {
  const auto& [section, key, value, line] = entry;
  bool sectionKnown = false;
  for (const Key& known : keys) {
    if (section != known.section) {
      continue;
    }
    sectionKnown = true;
    if (!takes(known, key)) {
      continue;
    }
    try {
      return known.set(configuration, key, value);
    } catch (const std::invalid_argument& error) {
      throw std::runtime_error("[" + section + "] " + key + " = " + value + ": " + error.what());
    }
  }
  if (sectionKnown) {
    throw std::runtime_error("[" + section + "] has no key '" + key + "': must be one of " + keysOf(section));
  }
  if (section.empty()) {
    throw std::runtime_error("the key '" + key + "' stands before any section: move it below its [section]");
  }
  if (!isBackEndSection(section, chosen)) {
    throw std::runtime_error("there is no section [" + section + "]: " + knownSections());
  }
  if (section == chosen) {
    configuration.backEndSettings[key] = value;
    configuration.backEndLines[key] = line;
  }
}

void requireFileName(const ChannelSettings& channel, const char* section, const std::string& fileName) {
  if (channel.destination == Destination::File && channel.file.empty()) {
    throw std::runtime_error(fileName + ": [" + section + "] destination is file, but the key 'file' is missing");
  }
}

}  // namespace

AgentConfiguration parseAgentConfiguration(std::istream& input, const std::string& fileName) {
  // Which sections there may be depends on a key that may stand below them. What is wrong with the form of the text
  // stops the reading, so that it comes after whatever is wrong with these entries.
  std::vector<Ground::IniEntry> entries;
  std::exception_ptr malformed;
  try {
    Ground::readIni(input, fileName, [&](const Ground::IniEntry& entry) { entries.push_back(entry); });
  } catch (const std::runtime_error&) {
    malformed = std::current_exception();
  }
  AgentConfiguration configuration;
  const std::string chosen = chosenBackEnd(entries);
  std::set<std::pair<std::string, std::string>> seen;
  for (const Ground::IniEntry& entry : entries) {
    try {
      if (!seen.emplace(entry.section, entry.key).second) {
        throw std::runtime_error("[" + entry.section + "] " + entry.key + ": duplicate");
      }
      set(configuration, entry, chosen);
    } catch (const std::runtime_error& error) {
      throw std::runtime_error(fileName + ":" + std::to_string(entry.line) + ": " + error.what());
    }
  }
  if (malformed) {
    std::rethrow_exception(malformed);
  }
  requireFileName(configuration.log, "log", fileName);
  requireFileName(configuration.trace, "trace", fileName);
  return configuration;
}

std::string agentConfigurationFile() {
  const char* chosen = std::getenv("QV_AGENT_INI");
  return chosen ? chosen : CONFIGURATION_DIR "/agent.ini";
}

AgentConfiguration readAgentConfiguration() {
  const std::string fileName = agentConfigurationFile();
  errno = 0;
  std::ifstream file(fileName);
  if (!file) {
    const int error = errno;
    throw std::runtime_error(fileName + ": cannot be opened: " + std::strerror(error) + "; " + remedyFor(error));
  }
  return parseAgentConfiguration(file, fileName);
}

}  // namespace QV
