// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/ParameterTransaction.h"

#include <thread>

#include "agent/backends/ipmi/lan/LanParameters.h"
#include "agent/backends/ipmi/session/Deadline.h"
#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

constexpr std::chrono::milliseconds betweenRequests{50};
constexpr int releaseAttempts = 3;

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

IpmiResponse askForLock(IpmiTransport& transport, std::uint8_t channel) {
  return setProgress(transport, channel, SetProgress::InProgress, Repetition::Forbidden);
}

// Asks for the lock until it is not refused any more, because its holder has given it back, or patience is over.
IpmiResponse insistOnLock(IpmiTransport& transport, std::uint8_t channel, std::chrono::milliseconds patience) {
  for (const Deadline deadline(patience);;) {
    IpmiResponse response = askForLock(transport, channel);
    if (response.completionCode != CompletionCode::setInProgress || deadline.passed()) {
      return response;
    }
    std::this_thread::sleep_for(betweenRequests);
  }
}

}  // namespace

void releaseLock(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held, std::chrono::milliseconds patience) {
  try {
    const bool surelyOurs = held.at(channel) == LockHolder::Us;
    if (!surelyOurs) {
      insistOnLock(transport, channel, patience);
    }
    IpmiResponse response;
    for (int attempt = 0; attempt < releaseAttempts; ++attempt) {
      if (attempt > 0) {
        std::this_thread::sleep_for(betweenRequests);
      }
      response = setProgress(transport, channel, SetProgress::Complete, Repetition::Allowed);
      if (response.completionCode == CompletionCode::done || (!surelyOurs && meansNoLock(response.completionCode))) {
        held.erase(channel);
        return;
      }
    }
    logFailure(
        "the set-in-progress lock of " + nameOf(channel) +
        " is not given back; the next operation tries again: " + CompletionCode::describe(response.completionCode));
  } catch (const IpmiError& error) {
    logFailure("the set-in-progress lock of " + nameOf(channel) +
               " may stay set; the next operation gives it back: " + error.what());
  }
}

ParameterTransaction::ParameterTransaction(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held,
                                           std::chrono::milliseconds patience)
    : transport_(transport), channel_(channel), held_(held), patience_(patience) {
  try {
    take();
  } catch (const IpmiError&) {
    giveBack();
    throw;
  }
}

// Whoever asks for the lock and is not refused has it: to look first whether it is free would cost a round trip more.
void ParameterTransaction::take() {
  IpmiResponse response;
  try {
    response = askForLock(transport_, channel_);
    // What is written without a lock to a processor that has one waits for the next client's commit: better sure.
    if (meansNoLock(response.completionCode)) {
      response = askForLock(transport_, channel_);
    }
  } catch (const ConnectionLost&) {
    held_[channel_] = LockHolder::PerhapsAnother;
    throw;
  }
  // Where the request had to be sent twice, this may be the answer to the second, and the first has taken the lock.
  if (response.completionCode == CompletionCode::setInProgress && response.late) {
    held_[channel_] = LockHolder::PerhapsAnother;
    response = insistOnLock(transport_, channel_, patience_);
    if (response.completionCode == CompletionCode::setInProgress) {
      logProgress("the lock of " + nameOf(channel_) + " is taken to be ours: the answer that granted it was lost");
      response.completionCode = CompletionCode::done;
    }
  }
  if (response.completionCode == CompletionCode::done) {
    held_[channel_] = LockHolder::Us;
    return;
  }
  held_.erase(channel_);
  if (response.completionCode == CompletionCode::setInProgress) {
    throw LockedByAnother(busyText(channel_));
  }
  if (!meansNoLock(response.completionCode)) {
    throw IpmiError(nameOf(channel_) + " cannot be changed: " + CompletionCode::describe(response.completionCode));
  }
  logProgress(nameOf(channel_) + " has no set-in-progress lock: its parameters are written without");
}

void ParameterTransaction::giveBack() {
  if (!held_.contains(channel_)) {
    return;
  }
  transport_.beginCleanup();
  releaseLock(transport_, channel_, held_, patience_);
}

ParameterTransaction::~ParameterTransaction() { giveBack(); }

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
