// SPDX-License-Identifier: Apache-2.0
// The management processor of a machine that has none: a state file that several processes may share.
#pragma once

#include <mutex>
#include <optional>
#include <string>

#include "agent/backends/simulated/StateFile.h"
#include "agent/processor/BackEnd.h"

namespace QV {

class SimulatedBackEnd : public BackEnd {
 public:
  // Makes the file's directory if it is missing; the first read or change writes the factory configuration if
  // there is no file. Throws std::runtime_error with what to do if the file could not be changed later.
  explicit SimulatedBackEnd(const std::string& stateFile);

  // The file is looked at each time, since other processes change it, and read anew where it is another than before. A
  // damaged file is an error that names the field, and no change overwrites it.
  ManagementProcessor read() override;
  void change(const std::string& interfaceName, const AddressChange& change) override;

 private:
  ManagementProcessor readState();
  ManagementProcessor parse(const std::string& text) const;

  // What a version of the file was read as.
  struct Known {
    StateFile::Version version;
    ManagementProcessor processor;
  };

  const StateFile file_;
  std::mutex mutex_;
  std::optional<Known> known_;
};

// The state file that the section [simulated] names, or the usual one. Throws Ground::RefusedSetting.
std::string parseSimulatedSettings(const BackEndSettings& section);

// A simulated processor's description, which says so itself or is made to; an empty one stays empty.
std::string describedAsSimulated(const std::string& description);

// What a new simulated processor has: an interface with static addresses, one that is configured by DHCP, and two name
// servers, all of the address blocks that are set aside for documentation (RFC 5737, RFC 3849).
ManagementProcessor factoryConfiguration();

}  // namespace QV
