// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/IpmiBackEnd.h"

#include <atomic>
#include <stdexcept>
#include <type_traits>

#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

// Runs on the operation's thread, so that the log tells how it ended even if the caller has left.
template <typename Operation>
auto logged(const std::string& what, Operation operation) try {
  return operation();
} catch (const std::exception& error) {
  logFailure(what + ": " + error.what());
  throw;
}

void changeOrSayNothingWasChanged(IpmiProcessor& processor, Deadline deadline, const std::string& interfaceName,
                                  const AddressChange& change, std::atomic<bool>& begun) try {
  processor.change(deadline, interfaceName, change, begun);
} catch (const IpmiError& error) {
  if (begun) {
    throw;
  }
  throw IpmiError(std::string(error.what()) + "; nothing was changed");
}

std::string describe(const std::string& name, const AddressChange& change) {
  std::string text = "change of " + name;
  if (change.ipv4Address) {
    text += " to IP address " + change.ipv4Address->text();
  }
  if (change.ipv4SubnetMask) {
    text += (change.ipv4Address ? ", subnet mask " : " to subnet mask ") + change.ipv4SubnetMask->text();
  }
  return text;
}

}  // namespace

IpmiBackEnd::IpmiBackEnd(const IpmiSettings& settings)
    : settings_(settings),
      processor_(std::make_shared<IpmiProcessor>(settings)),
      thread_(IpmiSession::longestIdle(settings), [processor = processor_] { processor->close(); }) {}

template <typename Look>
auto IpmiBackEnd::look(const std::string& what, Look look) {
  const Deadline deadline(settings_.operationTimeout);
  try {
    return thread_.run(deadline, [processor = processor_, deadline, what, look] {
      return logged(what, [&] { return look(*processor, deadline); });
    });
  } catch (const Overdue&) {
    const std::string text = what + ": no answer within operation_timeout";
    logFailure(text);
    throw std::runtime_error(text);
  }
}

ManagementProcessor IpmiBackEnd::read() {
  return look("reading " + nameOf(settings_),
              [](IpmiProcessor& processor, Deadline deadline) { return processor.read(deadline); });
}

InterfaceNames IpmiBackEnd::interfaceNames() {
  return look("finding the interfaces of " + nameOf(settings_),
              [](IpmiProcessor& processor, Deadline deadline) { return processor.interfaceNames(deadline); });
}

void IpmiBackEnd::change(const std::string& interfaceName, const AddressChange& change) {
  const Deadline deadline(settings_.operationTimeout);
  const std::string what = describe(interfaceName, change) + " at " + nameOf(settings_);
  const auto begun = std::make_shared<std::atomic<bool>>(false);
  try {
    thread_.run(deadline, [processor = processor_, deadline, what, interfaceName, change, begun] {
      logged(what, [&] { changeOrSayNothingWasChanged(*processor, deadline, interfaceName, change, *begun); });
      logProgress(what + ": done and confirmed");
    });
  } catch (const Overdue&) {
    const std::string text =
        what + ": not ended within operation_timeout; " +
        (*begun ? "the outcome is unknown: read the interface before trying again" : "nothing was changed");
    logFailure(text);
    throw std::runtime_error(text);
  }
}

}  // namespace QV::Ipmi

extern "C" __attribute__((visibility("default"))) QV::BackEnd* qvCreateBackEnd(const QV::BackEndSettings& settings) {
  return new QV::Ipmi::IpmiBackEnd(QV::Ipmi::parseSettings(settings));
}

static_assert(std::is_same_v<decltype(qvCreateBackEnd), QV::CreateBackEnd>);
