// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/ParameterTransaction.h"

#include "agent/backends/ipmi/lan/LanParameters.h"
#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

IpmiResponse setProgress(IpmiTransport& transport, std::uint8_t channel, SetProgress progress, Repetition repetition) {
  return setParameter(transport, channel, LanParameter::SetInProgress, {static_cast<std::uint8_t>(progress)},
                      repetition);
}

std::string nameOf(std::uint8_t channel) { return "LAN channel " + std::to_string(channel); }

std::string busyText(std::uint8_t channel) {
  return nameOf(channel) +
         " is being changed by another client, or one that crashed left its lock behind (set in progress, 0x81): try "
         "again later; where no other tool is at work, give the lock back with: ipmitool raw 0x0c 0x01 " +
         std::to_string(channel) + " 0 0";
}

bool meansNoLock(std::uint8_t completionCode) {
  return completionCode == CompletionCode::parameterNotSupported || completionCode == CompletionCode::readOnly ||
         completionCode == CompletionCode::parameterOutOfRange || completionCode == CompletionCode::invalidData;
}

}  // namespace

void releaseLock(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held) {
  try {
    const IpmiResponse response = setProgress(transport, channel, SetProgress::Complete, Repetition::Allowed);
    if (response.completionCode == CompletionCode::done) {
      held.erase(channel);
    } else {
      logFailure("the set-in-progress lock of " + nameOf(channel) +
                 " is not given back: " + CompletionCode::describe(response.completionCode));
    }
  } catch (const IpmiError& error) {
    logFailure("the set-in-progress lock of " + nameOf(channel) +
               " may stay set; the next operation gives it back: " + error.what());
  }
}

ParameterTransaction::ParameterTransaction(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held)
    : transport_(transport), channel_(channel), held_(held) {
  try {
    take();
  } catch (const ConnectionLost&) {
    transport_.beginCleanup();
    releaseLock(transport_, channel_, held_);
    throw;
  }
}

void ParameterTransaction::take() {
  const auto progress = getParameter(transport_, channel_, LanParameter::SetInProgress);
  const bool known = progress && !progress->empty();
  if (known && static_cast<SetProgress>(progress->front() & 0x03) != SetProgress::Complete) {
    throw IpmiError(busyText(channel_));
  }

  held_.insert(channel_);
  const IpmiResponse response = setProgress(transport_, channel_, SetProgress::InProgress, Repetition::Forbidden);
  if (response.completionCode == CompletionCode::done) {
    return;
  }
  // The lock was free a moment ago; where the request had to be sent twice, the first took it.
  if (response.completionCode == CompletionCode::setInProgress && known && response.late) {
    return;
  }
  held_.erase(channel_);
  if (response.completionCode == CompletionCode::setInProgress) {
    throw IpmiError(busyText(channel_));
  }
  if (!meansNoLock(response.completionCode)) {
    throw IpmiError(nameOf(channel_) + " cannot be changed: " + CompletionCode::describe(response.completionCode));
  }
  logProgress(nameOf(channel_) + " has no set-in-progress lock: its parameters are written without");
}

ParameterTransaction::~ParameterTransaction() {
  if (!held_.contains(channel_)) {
    return;
  }
  transport_.beginCleanup();
  releaseLock(transport_, channel_, held_);
}

void ParameterTransaction::write(const std::vector<ParameterWrite>& writes) {
  std::size_t written = 0;
  try {
    for (; written < writes.size(); ++written) {
      writeOne(writes[written]);
    }
  } catch (const ConnectionLost&) {
    throw;
  } catch (const IpmiError& error) {
    throw IpmiError(error.what() + putBack(writes, written));
  }
  commit();
}

void ParameterTransaction::writeOne(const ParameterWrite& write) {
  const IpmiResponse response = setParameter(transport_, channel_, write.parameter, write.value, Repetition::Forbidden);
  if (response.completionCode != CompletionCode::done) {
    throw IpmiError("the BMC refuses the " + write.describe() + " on " + nameOf(channel_) + ": " +
                    CompletionCode::describe(response.completionCode));
  }
}

// The commit matters on processors that stage their writes too: what is staged and left would go out with the next
// client's commit.
std::string ParameterTransaction::putBack(const std::vector<ParameterWrite>& writes, std::size_t count) try {
  transport_.beginCleanup();
  while (count-- > 0) {
    const ParameterWrite& write = writes[count];
    if (!write.previous) {
      throw IpmiError("the earlier " + Ipmi::describe(write.parameter) + " is not known");
    }
    writeOne({write.parameter, *write.previous, write.value});
  }
  commit();
  return "; nothing was changed";
} catch (const IpmiError& error) {
  return std::string("; what was written before could not be put back: ") + error.what();
}

// Whether a processor applies on commit, at once or only at the end is its own; reading back tells.
void ParameterTransaction::commit() {
  if (!held_.contains(channel_)) {
    return;
  }
  const IpmiResponse response = setProgress(transport_, channel_, SetProgress::CommitWrite, Repetition::Forbidden);
  if (response.completionCode != CompletionCode::done) {
    trace(nameOf(channel_) + " does not commit: " + CompletionCode::describe(response.completionCode));
  }
}

}  // namespace QV::Ipmi
