// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/ProviderFrame.h"

#include <pthread.h>

#include <exception>

namespace Cimom {
namespace {

thread_local unsigned frames = 0;
thread_local std::string ended;

}  // namespace

ProviderFrame::ProviderFrame() {
  pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, &cancellation_);
  ++frames;
}

ProviderFrame::~ProviderFrame() {
  --frames;
  pthread_setcancelstate(cancellation_, nullptr);
}

bool ProviderFrame::isOnThisThread() { return frames > 0; }

void ProviderFrame::endThread(const std::string& what) noexcept {
  try {
    if (ended.empty()) {
      ended = what + " ended the thread of its request";
    }
  } catch (const std::exception&) {
    // Without memory for the name the answer goes without it.
  }
}

const std::string& ProviderFrame::endedBy() { return ended; }

}  // namespace Cimom
