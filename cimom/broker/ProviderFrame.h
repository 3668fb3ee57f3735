// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace Cimom {

// Ends a provider's call whose provider has asked for the end of its thread.
struct ThreadExit {};

// A call of a provider's function on this thread. As long as it lasts nobody cancels the thread.
class ProviderFrame {
 public:
  ProviderFrame();
  ~ProviderFrame();
  ProviderFrame(const ProviderFrame&) = delete;
  ProviderFrame& operator=(const ProviderFrame&) = delete;

  static bool isOnThisThread();

  // A provider that goes past the broker and calls pthread_exit ends the thread for good: all of its frames are
  // unwound. Who serves requests on the thread answers then, with what stands here: who has ended it, or nothing.
  static void endThread(const std::string& what) noexcept;
  static const std::string& endedBy();

 private:
  int cancellation_ = 0;
};

}  // namespace Cimom
