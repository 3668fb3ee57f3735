// SPDX-License-Identifier: Apache-2.0
// The simulated processor with a record of what reaches it, and a switch that makes it unreachable.
#pragma once

#include <stdexcept>
#include <string>
#include <vector>

#include "agent/backends/simulated/SimulatedBackEnd.h"

namespace QV {

class RecordingBackEnd : public SimulatedBackEnd {
 public:
  using SimulatedBackEnd::SimulatedBackEnd;

  ManagementProcessor read() override {
    ++reads;
    return SimulatedBackEnd::read();
  }

  // Counts as no read: this is what a processor does whose values cost more than their names.
  InterfaceNames interfaceNames() override {
    InterfaceNames names = SimulatedBackEnd::interfaceNames();
    --reads;
    return names;
  }

  void change(const std::string& interfaceName, const AddressChange& change) override {
    changes.push_back(interfaceName + " " + textOf(change.ipv4Address) + " " + textOf(change.ipv4SubnetMask));
    if (unreachable) {
      throw std::runtime_error("the processor does not answer");
    }
    SimulatedBackEnd::change(interfaceName, change);
  }

  template <typename Address>
  static std::string textOf(const std::optional<Address>& address) {
    return address ? address->text() : "-";
  }

  std::vector<std::string> changes;  // "INTERFACE ADDRESS MASK", an absent value as "-"
  unsigned reads = 0;                // of the values
  bool unreachable = false;
};

}  // namespace QV
