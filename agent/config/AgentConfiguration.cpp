#include "agent/config/AgentConfiguration.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <set>
#include <stdexcept>
#include <utility>
#include <vector>

#include "agent/config/IniFile.h"

namespace QV {
namespace {

using Destination = ChannelSettings::Destination;

// The enumerator that a word stands for.
template <typename Enumeration, std::size_t Count>
Enumeration choose(const std::string& value, const std::array<std::pair<const char*, Enumeration>, Count>& words) {
  std::string expected;
  for (const auto& [word, meaning] : words) {
    if (value == word) return meaning;
    expected += (expected.empty() ? "" : " | ") + std::string(word);
  }
  throw std::invalid_argument("'" + value + "' is not one of " + expected);
}

int level(const std::string& value) {
  int number = 0;
  const char* end = value.data() + value.size();
  const auto [stop, error] = std::from_chars(value.data(), end, number);
  if (error != std::errc{} || stop != end || number < 0)
    throw std::invalid_argument("'" + value + "' is not a level: a whole number from 0 on");
  return number;
}

std::string absolutePath(const std::string& value) {
  if (!value.starts_with('/')) throw std::invalid_argument("'" + value + "' is not an absolute path");
  return value;
}

std::string text(const std::string& value) {
  if (value.empty()) throw std::invalid_argument("the value is missing");
  return value;
}

Destination destination(const std::string& value) {
  return choose(value, std::array{std::pair{"off", Destination::Off}, std::pair{"syslog", Destination::Syslog},
                                  std::pair{"stderr", Destination::Stderr}, std::pair{"file", Destination::File}});
}

AgentConfiguration::BackEndKind backEnd(const std::string& value) {
  using Kind = AgentConfiguration::BackEndKind;
  return choose(value, std::array{std::pair{"simulated", Kind::Simulated}, std::pair{"ipmi", Kind::Ipmi}});
}

constexpr const char* componentThreshold = "threshold.";

struct Key {
  const char* section;
  const char* name;  // a name that ends in '.' takes any key that starts so; an empty one takes every key
  void (*set)(AgentConfiguration& configuration, const std::string& key, const std::string& value);
};

using Configuration = AgentConfiguration;
using Text = const std::string;

const Key keys[] = {
    {"system", "name", [](Configuration& c, Text&, Text& value) { c.systemName = text(value); }},
    {"log", "destination", [](Configuration& c, Text&, Text& value) { c.log.destination = destination(value); }},
    {"log", "file", [](Configuration& c, Text&, Text& value) { c.log.file = absolutePath(value); }},
    {"log", "threshold", [](Configuration& c, Text&, Text& value) { c.log.threshold = level(value); }},
    {"log", componentThreshold,
     [](Configuration& c, Text& key, Text& value) {
       c.log.componentThresholds[key.substr(std::strlen(componentThreshold))] = level(value);
     }},
    {"trace", "destination", [](Configuration& c, Text&, Text& value) { c.trace.destination = destination(value); }},
    {"trace", "file", [](Configuration& c, Text&, Text& value) { c.trace.file = absolutePath(value); }},
    {"trace", "threshold", [](Configuration& c, Text&, Text& value) { c.trace.threshold = level(value); }},
    {"trace", componentThreshold,
     [](Configuration& c, Text& key, Text& value) {
       c.trace.componentThresholds[key.substr(std::strlen(componentThreshold))] = level(value);
     }},
    {"processor", "backend", [](Configuration& c, Text&, Text& value) { c.backEnd = backEnd(value); }},
    {"processor", "name", [](Configuration& c, Text&, Text& value) { c.processorName = text(value); }},
    {"processor", "description", [](Configuration& c, Text&, Text& value) { c.processorDescription = text(value); }},
    {"simulated", "state", [](Configuration& c, Text&, Text& value) { c.simulatedState = absolutePath(value); }},
    {"ipmi", "", [](Configuration& c, Text& key, Text& value) { c.ipmi[key] = value; }},
};

bool takes(const Key& known, const std::string& key) {
  const std::string name = known.name;
  if (name.empty()) return true;
  return name.ends_with('.') ? key.starts_with(name) && key.size() > name.size() : key == name;
}

void set(AgentConfiguration& configuration, const std::string& section, const std::string& key,
         const std::string& value) {
  bool sectionKnown = false;
  for (const Key& known : keys) {
    if (section != known.section) continue;
    sectionKnown = true;
    if (!takes(known, key)) continue;
    try {
      return known.set(configuration, key, value);
    } catch (const std::invalid_argument& error) {
      throw std::invalid_argument("[" + section + "] " + key + ": " + error.what());
    }
  }
  if (section.empty()) throw std::invalid_argument("the key '" + key + "' stands before any section");
  if (!sectionKnown) throw std::invalid_argument("there is no section [" + section + "]");
  throw std::invalid_argument("[" + section + "] has no key '" + key + "'");
}

void requireFileName(const ChannelSettings& channel, const char* section, const std::string& fileName) {
  if (channel.destination == Destination::File && channel.file.empty())
    throw std::runtime_error(fileName + ": [" + section + "] destination is file, but the key 'file' is missing");
}

}  // namespace

AgentConfiguration parseAgentConfiguration(std::istream& input, const std::string& fileName) {
  AgentConfiguration configuration;
  std::set<std::pair<std::string, std::string>> seen;
  readIni(input, fileName, [&](const std::string& section, const std::string& key, const std::string& value) {
    if (!seen.emplace(section, key).second)
      throw std::invalid_argument("[" + section + "] " + key + " is given a second time");
    set(configuration, section, key, value);
  });
  requireFileName(configuration.log, "log", fileName);
  requireFileName(configuration.trace, "trace", fileName);
  return configuration;
}

AgentConfiguration readAgentConfiguration() {
  const char* chosen = std::getenv("QV_AGENT_INI");
  const std::string fileName = chosen ? chosen : DEFAULT_AGENT_INI;
  errno = 0;
  std::ifstream file(fileName);
  if (!file) {
    if (!chosen && errno == ENOENT) return {};
    throw std::runtime_error(fileName + ": cannot be opened: " + std::strerror(errno));
  }
  return parseAgentConfiguration(file, fileName);
}

}  // namespace QV
