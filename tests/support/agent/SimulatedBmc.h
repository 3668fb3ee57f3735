// SPDX-License-Identifier: Apache-2.0
// A BMC for tests: OpenIPMI's simulator, which speaks RMCP+ over UDP like a real one, run by tools/ipmi-sim-bmc.
#pragma once

#include <sys/types.h>

#include <cstdint>
#include <memory>
#include <string>

#include "agent/processor/BackEnd.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

class SimulatedBmc {
 public:
  enum class Personality { AppliesOnCommit, AppliesAtOnce };

  explicit SimulatedBmc(Personality personality = Personality::AppliesOnCommit);
  ~SimulatedBmc();

  // It has LAN channel 1: 192.0.2.10/255.255.255.0 from DHCP, gateway 192.0.2.1, MAC 02:00:00:00:00:01, unless it
  // applies at once: then all is zero.
  std::uint16_t port() const { return port_; }

  // A section of agent.ini that reaches it through the given port of this machine; 0 means its own. Nothing is cached,
  // and an operation has the time that it takes on a machine that stalls.
  QV::BackEndSettings settings(std::uint16_t port = 0) const;

  // The same with times that no busy machine takes: whoever counts what is sent must neither repeat a request nor give
  // an idle session back.
  QV::BackEndSettings patientSettings(std::uint16_t port = 0) const;

  // What ipmitool says: of a value that `lan print` shows, "IP Address Source" say; of any command.
  std::string witness(const std::string& label) const;
  std::string ipmitool(const std::vector<std::string>& command) const;

  // The file in which processes with these settings tell each other of changes.
  std::string generationFile() const { return directory_ / "generation"; }

  // A shell script that runs before the simulator gets, sets or checks a LAN parameter ("get", "set", "check"); where
  // it fails, so does the simulator's step. $SIMULATOR is its process. Works with Personality::AppliesOnCommit.
  void hook(const std::string& step, const std::string& script) const;
  void removeHook(const std::string& step) const;

  // What it stores under a key of its own: ip_addr, ip_addr_src, subnet_mask. Personality::AppliesOnCommit.
  std::string stored(const std::string& key) const;

  // Stalls it and lets it go on; ends it without a word and starts it again on its port.
  void halt() const;
  void resume() const;
  void kill();
  void restart();

 private:
  void start();
  void stop();
  pid_t simulator() const;

  Testing::TemporaryDirectory directory_;
  Personality personality_;
  std::uint16_t port_ = 0;
  std::unique_ptr<Process> process_;
};

}  // namespace Testing
