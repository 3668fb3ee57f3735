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

  void change(const std::string& interfaceName, const AddressChange& change) override {
    changes.push_back(interfaceName + " " + change.ipv4Address.value_or("-") + " " +
                      change.ipv4SubnetMask.value_or("-"));
    if (unreachable) throw std::runtime_error("the processor does not answer");
    SimulatedBackEnd::change(interfaceName, change);
  }

  std::vector<std::string> changes;  // "INTERFACE ADDRESS MASK", an absent value as "-"
  bool unreachable = false;
};

}  // namespace QV
