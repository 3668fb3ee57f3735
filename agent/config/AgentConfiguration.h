// The agent's configuration, agent.ini: what every library of the agent reads on its first use.
#pragma once

#include <istream>
#include <map>
#include <string>

namespace QV {

// One of the two message channels, [log] and [trace].
struct ChannelSettings {
  enum class Destination { Off, Syslog, Stderr, File };

  Destination destination = Destination::Off;
  std::string file;                                // absolute; named where the destination is File
  int threshold = 0;                               // the least level that passes
  std::map<std::string, int> componentThresholds;  // overrides `threshold` for the components that it names
};

struct AgentConfiguration {
  using Section = std::map<std::string, std::string>;

  std::string systemName;  // empty: the host name
  ChannelSettings log{ChannelSettings::Destination::Syslog, {}, 6000, {}};
  ChannelSettings trace{ChannelSettings::Destination::Off, {}, 4000, {}};
  bool publishesHost = false;  // whether the underlying classes show the host beside the processor
  std::string backEnd;         // a name of letters, digits and '-'; empty: none is chosen
  Section backEndSettings;     // the section of that name as it stands: its keys are the back end's own
  std::map<std::string, unsigned> backEndLines;  // the line on which each of these stands
  std::string processorName;                     // empty: what the processor itself says
  std::string processorDescription;              // empty: what the processor itself says
};

// The file of the configuration that is in force: the one that the environment variable QV_AGENT_INI names, else
// agent.ini in the configuration directory.
std::string agentConfigurationFile();

// The configuration that is in force. Throws std::runtime_error in words that name the file, the line, what is wrong
// with it and what to do; a file that is not there is an error like any other, since nothing stands in for the choice
// of a management processor.
AgentConfiguration readAgentConfiguration();

// The configuration that a text in agent.ini's form tells. `fileName` is for the messages.
AgentConfiguration parseAgentConfiguration(std::istream& text, const std::string& fileName);

}  // namespace QV
