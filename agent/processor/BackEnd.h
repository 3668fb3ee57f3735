// SPDX-License-Identifier: Apache-2.0
// The seam between the agent and a management processor. An implementation reaches one processor; the instrumentation
// and the underlying provider share it within a process.
#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "agent/processor/ManagementProcessor.h"

namespace QV {

// Absent where an interface's name cannot be read.
using InterfaceNames = std::vector<std::optional<std::string>>;

class BackEnd {
 public:
  virtual ~BackEnd() = default;

  // The processor as it is now. Throws std::runtime_error in words an administrator can act on. Safe to call from
  // several threads at once.
  virtual ManagementProcessor read() = 0;

  // The names of its interfaces, in their order. Whoever looks for one interface needs no more, and where the values
  // cost exchanges with hardware the names may cost none. Throws and is safe as read() is.
  virtual InterfaceNames interfaceNames();

  // Changes the interface of that name; its source becomes static. Returns when the processor has taken the change and
  // confirmed it; throws std::runtime_error where it was refused, could not be sent, or its outcome is unknown. The
  // values have been validated. Safe to call from several threads at once.
  virtual void change(const std::string& interfaceName, const AddressChange& change) = 0;
};

inline InterfaceNames BackEnd::interfaceNames() {
  InterfaceNames names;
  for (const NetworkInterface& interface : read().interfaces) {
    names.push_back(interface.name);
  }
  return names;
}

// The keys and values of the back end's own section of agent.ini. An unknown key or a malformed value is refused by the
// back end's constructor with a Ground::RefusedSetting, to which the agent adds file and line.
using BackEndSettings = std::map<std::string, std::string>;

// What the back end NAME exports from its library, libqvbmc-NAME.so, with C linkage, under the name "qvCreateBackEnd".
// The caller owns the result. Throws as a constructor does.
using CreateBackEnd = BackEnd*(const BackEndSettings& settings);

}  // namespace QV
