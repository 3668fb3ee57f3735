// SPDX-License-Identifier: Apache-2.0
#include "tests/agent/backends/ipmi/faults/CommandFaults.h"

#include <dlfcn.h>
#include <freeipmi/freeipmi.h>

#include <algorithm>
#include <mutex>
#include <optional>
#include <thread>

namespace Testing {
namespace {

std::mutex mutex;
std::thread::id undisturbed;
unsigned sent = 0;
unsigned disturbedNumber = 0;
CommandFault fault{};
bool struck = false;

bool lockless = false;

// Set LAN Configuration Parameters, parameter 0.
bool concernsLock(std::uint8_t networkFunction, const std::uint8_t* request, unsigned size) {
  constexpr std::uint8_t transport = 0x0C, setParameters = 0x01, setInProgress = 0;
  return networkFunction == transport && size > 2 && request[0] == setParameters && request[2] == setInProgress;
}

std::optional<CommandFault> faultOf(std::uint8_t networkFunction, const void* request, unsigned size) {
  const std::lock_guard lock(mutex);
  if (std::this_thread::get_id() == undisturbed) {
    return std::nullopt;
  }
  const bool refused = lockless && concernsLock(networkFunction, static_cast<const std::uint8_t*>(request), size);
  if (++sent == disturbedNumber) {
    struck = true;
    return refused && fault.kind != CommandFault::Kind::Refused ? CommandFault{CommandFault::Kind::LostBefore} : fault;
  }
  return refused ? std::optional(CommandFault{CommandFault::Kind::Refused, 0x80}) : std::nullopt;
}

}  // namespace

void disturbCommand(unsigned number, const CommandFault& kind) {
  const std::lock_guard lock(mutex);
  undisturbed = std::this_thread::get_id();
  sent = 0;
  disturbedNumber = number;
  fault = kind;
  struck = false;
}

bool undisturbCommands() {
  const std::lock_guard lock(mutex);
  disturbedNumber = 0;
  return struck;
}

void withoutLock(bool without) {
  const std::lock_guard lock(mutex);
  undisturbed = std::this_thread::get_id();
  lockless = without;
}

unsigned commandsSent() {
  const std::lock_guard lock(mutex);
  return sent;
}

}  // namespace Testing

// The linker finds this one for the back end's objects in the same program; libfreeipmi's own comes next.
extern "C" int ipmi_cmd_raw(ipmi_ctx_t context, std::uint8_t lun, std::uint8_t networkFunction, const void* request,
                            unsigned requestSize, void* answer, unsigned answerSize) {
  using Kind = Testing::CommandFault::Kind;
  static const auto real = reinterpret_cast<decltype(&ipmi_cmd_raw)>(::dlsym(RTLD_NEXT, "ipmi_cmd_raw"));
  const auto wanted = Testing::faultOf(networkFunction, request, requestSize);
  if (wanted && wanted->kind == Kind::LostBefore) {
    return -1;
  }
  if (wanted && wanted->kind == Kind::Refused) {
    auto* const bytes = static_cast<std::uint8_t*>(answer);
    bytes[0] = *static_cast<const std::uint8_t*>(request);
    bytes[1] = wanted->completionCode;
    return 2;
  }
  const int length = real(context, lun, networkFunction, request, requestSize, answer, answerSize);
  if (!wanted || length < 0) {
    return length;
  }
  switch (wanted->kind) {
    case Kind::CutToNothing:
      return std::min(length, 1);
    case Kind::CutToCode:
      return std::min(length, 2);
    case Kind::CutByOne:
      return length - 1;
    default:
      return -1;
  }
}
