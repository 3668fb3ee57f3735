// SPDX-License-Identifier: Apache-2.0
// The back end that reaches a management processor through IPMI, in-band or over LAN.
#pragma once

#include <memory>
#include <string>

#include "agent/backends/ipmi/IpmiProcessor.h"
#include "agent/backends/ipmi/session/OperationThread.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"
#include "agent/processor/BackEnd.h"

namespace QV::Ipmi {

// Opens nothing before it is first asked. Every read and change returns or throws within the operation time-out, even
// where the processor, the network or a driver stalls; failures go to the log too.
class IpmiBackEnd : public BackEnd {
 public:
  explicit IpmiBackEnd(const IpmiSettings& settings);

  ManagementProcessor read() override;
  InterfaceNames interfaceNames() override;
  void change(const std::string& interfaceName, const AddressChange& change) override;

 private:
  // Runs an operation that changes nothing on the thread, within the operation time-out.
  template <typename Look>
  auto look(const std::string& what, Look look);

  const IpmiSettings settings_;
  const std::shared_ptr<IpmiProcessor> processor_;  // the thread's alone
  OperationThread thread_;
};

}  // namespace QV::Ipmi
