// SPDX-License-Identifier: Apache-2.0
// A BMC of any temper, for those that the simulator does not have: it answers requests directly.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <set>
#include <vector>

#include "agent/backends/ipmi/lan/LanParameters.h"

namespace Testing {

using QV::Ipmi::IpmiRequest;
using QV::Ipmi::IpmiResponse;
using QV::Ipmi::LanParameter;
using QV::Ipmi::ParameterData;

class ScriptedBmc : public QV::Ipmi::IpmiTransport {
 public:
  enum class Applies { AtOnce, OnCommit, OnComplete, Never };

  // Its temper.
  Applies applies = Applies::OnCommit;
  bool hasLock = true;
  bool busy = false;             // refuses what concerns the lock
  bool lockedByAnother = false;  // and stays so
  bool refusesAddressUnderDhcp = false;
  unsigned readsUntilApplied = 0;                    // reads of the address that still show the earlier values
  std::map<LanParameter, std::uint8_t> refuses;      // completion codes of writes
  std::map<LanParameter, std::uint8_t> readRefused;  // completion codes of reads

  // Called before each request with its number, the first being 1; may throw as a transport does.
  std::function<void(unsigned)> beforeRequest = [](unsigned) {};
  // The number of a request whose answer comes late, after it was sent twice.
  unsigned lateRequest = 0;

  // What it has, and what was written to it: parameter and data in order.
  std::map<LanParameter, ParameterData> values;
  std::vector<std::pair<LanParameter, ParameterData>> written;
  std::vector<std::uint8_t> progress;  // the same for the set-in-progress parameter
  std::set<std::uint8_t> lanChannels = {1};
  std::uint8_t presentChannel = 1;  // 15: the system interface
  bool locked = false;
  unsigned requests = 0;
  bool cleaningUp = false;

  // Static 192.0.2.10/255.255.255.0, gateway 192.0.2.1.
  ScriptedBmc();

  IpmiResponse send(const IpmiRequest& request, QV::Ipmi::Repetition repetition) override;
  void beginCleanup() override { cleaningUp = true; }

 private:
  IpmiResponse answer(const IpmiRequest& request);
  IpmiResponse channelInfo(std::uint8_t channel) const;
  IpmiResponse get(LanParameter parameter);
  std::uint8_t set(LanParameter parameter, const ParameterData& data);
  std::uint8_t setProgress(std::uint8_t step);
  void apply();

  std::map<LanParameter, ParameterData> staged_;
  std::optional<std::map<LanParameter, ParameterData>> earlier_;
};

}  // namespace Testing
