// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/session/IpmiConnection.h"

#include <algorithm>

#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {

void IpmiConnection::startOperation(Deadline deadline) {
  deadline_ = deadline;
  roundTrips_ = 0;
  if (session_ && session_->idle() >= IpmiSession::longestIdle(settings_)) {
    close();
  }
}

void IpmiConnection::beginCleanup() { deadline_ = std::max(deadline_, Deadline(settings_.sessionTimeout)); }

void IpmiConnection::requireTime() const {
  if (deadline_.passed()) {
    throw NotSent(nameOf(settings_) + " was too slow: operation_timeout is over");
  }
}

void IpmiConnection::open() {
  if (session_) {
    return;
  }
  requireTime();
  roundTrips_ += IpmiSession::openingRoundTrips(settings_);
  try {
    session_ = std::make_unique<IpmiSession>(settings_);
  } catch (const IpmiError&) {
    ++breaks_;
    throw;
  }
}

IpmiResponse IpmiConnection::send(const IpmiRequest& request, Repetition repetition) {
  const bool held = session_ != nullptr;
  open();
  requireTime();
  try {
    ++roundTrips_;
    return session_->send(request);
  } catch (const ConnectionLost& loss) {
    session_.reset();
    ++breaks_;
    const std::string what = nameOf(settings_) + " stopped answering: " + loss.what();
    if (!held || repetition == Repetition::Forbidden) {
      throw ConnectionLost(what);
    }
    logProgress(what + "; opening a new session");
  }
  return send(request, Repetition::Forbidden);
}

}  // namespace QV::Ipmi
