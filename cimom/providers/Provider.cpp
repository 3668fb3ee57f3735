// SPDX-License-Identifier: Apache-2.0
#include "cimom/providers/Provider.h"

#include <algorithm>
#include <array>
#include <future>
#include <thread>

#include "cimom/broker/BrokerCore.h"

namespace Cimom {
namespace {

// What a type of MI is called in the name of its factory.
template <typename Mi>
constexpr const char* kindOf = nullptr;
template <>
constexpr const char* kindOf<CMPIInstanceMI> = "Instance";
template <>
constexpr const char* kindOf<CMPIAssociationMI> = "Association";
template <>
constexpr const char* kindOf<CMPIMethodMI> = "Method";

constexpr std::array<CMPIrc, 6> codesBeyondCim = {CMPI_RC_DO_NOT_UNLOAD,      CMPI_RC_NEVER_UNLOAD,
                                                  CMPI_RC_ERR_INVALID_HANDLE, CMPI_RC_ERR_INVALID_DATA_TYPE,
                                                  CMPI_RC_ERROR_SYSTEM,       CMPI_RC_ERROR};

bool isReturnCode(CMPIrc code) {
  return (code >= CMPI_RC_OK && code <= CMPI_RC_ERR_METHOD_NOT_FOUND) ||
         std::ranges::find(codesBeyondCim, code) != codesBeyondCim.end();
}

// Whether a factory runs on this thread.
thread_local bool inFactory = false;

// Cleans one MI up. Returns whether its library may be unloaded.
template <typename Mi>
bool clean(const std::string& what, Mi* mi, const CMPIBroker* broker) {
  if (!mi || !mi->ft->cleanup) {
    return true;
  }
  const RequestScope scope(broker);
  try {
    constexpr CMPIBoolean terminating = true;
    runProvider(what, [&] { return mi->ft->cleanup(mi, RequestScope::current()->context(), terminating); });
  } catch (const StatusError& error) {
    // The provider knows of something that still runs in its code.
    if (error.code() != CMPI_RC_DO_NOT_UNLOAD && error.code() != CMPI_RC_NEVER_UNLOAD) {
      logError(coreOf(broker), what + " failed with return code " + std::to_string(error.code()) + ": " + error.what());
    }
    return false;
  }
  return true;
}

}  // namespace

void requireOk(const std::string& what, const CMPIStatus& status) {
  if (status.rc == CMPI_RC_OK) {
    return;
  }
  const std::string text = status.msg && status.msg->hdl ? textOf(status.msg) : "";
  if (isReturnCode(status.rc)) {
    throw StatusError(status.rc, text);
  }
  throw StatusError(CMPI_RC_ERR_FAILED, what + " returned " + std::to_string(static_cast<int>(status.rc)) +
                                            ", which is no return code of CMPI" + (text.empty() ? "" : ": " + text));
}

void reportThreadEnd(const std::string& what) noexcept {
  ProviderFrame::endThread(what);
  try {
    if (const CMPIBroker* broker = RequestScope::currentBroker()) {
      logError(coreOf(broker), what + " ended the thread of its request");
    }
  } catch (const std::exception&) {
    // Without memory for the line, the client's answer has to do.
  }
}

// The turn to load the library and to make an MI. Who makes one makes others by way of up-calls, so that whoever comes
// from a factory must not wait: two could wait for each other.
class Provider::Turn {
 public:
  Turn(Provider& provider, std::unique_lock<std::mutex>& lock, Limit limit) : provider_(provider) {
    if (provider.isBusy_ && inFactory) {
      throw StatusError(CMPI_RC_ERR_FAILED, "provider " + provider.name_ + " is still being made by its factory");
    }
    auto until = std::chrono::steady_clock::now() + limit;
    if (const Deadline deadline = RequestScope::currentDeadline()) {
      until = std::min(until, *deadline);
    }
    if (!provider.turnEnded_.wait_until(lock, until, [&] { return !provider.isBusy_; })) {
      throw StatusError(CMPI_RC_ERR_FAILED,
                        "provider " + provider.name_ + " is not ready: its factory does not return");
    }
    provider.isBusy_ = true;
  }

  ~Turn() {
    const std::lock_guard lock(provider_.mutex_);
    provider_.isBusy_ = false;
    provider_.turnEnded_.notify_all();
  }

  Turn(const Turn&) = delete;
  Turn& operator=(const Turn&) = delete;

 private:
  Provider& provider_;
};

Provider::Provider(std::string name, std::string location, const std::vector<std::filesystem::path>& directories)
    : name_(std::move(name)), location_(std::move(location)), directories_(&directories) {}

Provider::Provider(std::string name, ProviderFactories factories)
    : name_(std::move(name)), factories_(std::move(factories)) {}

void Provider::complete(ProviderFactories factories) {
  const auto add = [&](auto& mine, auto& given) {
    if (!mine) {
      mine = std::move(given);
    }
  };
  std::apply([&](auto&... mine) { std::apply([&](auto&... given) { (add(mine, given), ...); }, factories); },
             factories_);
}

template <typename Mi>
ProviderFactory<Mi>& Provider::requireFactory(const std::string& factoryName) {
  auto& factory = std::get<ProviderFactory<Mi>>(factories_);
  if (factory) {
    return factory;
  }
  if (isLinked()) {
    throw StatusError(CMPI_RC_ERR_FAILED, "provider " + name_ + " has no " + factoryName);
  }
  if (!library_) {
    library_ = ProviderLibrary(location_, *directories_);
  }
  return factory = library_.function<Mi*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>(factoryName);
}

template <typename Mi>
Mi* Provider::interface(const CMPIBroker* broker, Limit limit) {
  auto& mi = std::get<Mi*>(made_);
  std::unique_lock lock(mutex_);
  if (mi) {
    return mi;
  }
  const Turn turn(*this, lock, limit);
  if (mi) {
    lock.unlock();
    return mi;
  }
  lock.unlock();
  const std::string factoryName = name_ + "_Create_" + kindOf<Mi> + "MI";
  auto& factory = requireFactory<Mi>(factoryName);
  const RequestScope scope(broker);
  Mi* returned = nullptr;
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  struct InFactory {
    bool before = std::exchange(inFactory, true);
    ~InFactory() { inFactory = before; }
  };
  runProvider(factoryName, [&] {
    const InFactory inThisFactory;
    returned = factory(broker, RequestScope::current()->context(), &status);
    return status;
  });
  if (!returned || !returned->ft) {
    throw StatusError(CMPI_RC_ERR_FAILED, factoryName + " returned no management interface");
  }
  lock.lock();
  mi = returned;
  lock.unlock();
  return returned;
}

template CMPIInstanceMI* Provider::interface(const CMPIBroker*, Limit);
template CMPIAssociationMI* Provider::interface(const CMPIBroker*, Limit);
template CMPIMethodMI* Provider::interface(const CMPIBroker*, Limit);

bool Provider::cleanUp(const CMPIBroker* broker, Limit limit) {
  const auto made = std::exchange(made_, {});
  if (std::apply([](auto*... mi) { return (!mi && ...); }, made)) {
    return true;
  }
  const std::string what = "the clean-up of provider " + name_;
  const auto keep = [&](const std::string& why) {
    logError(coreOf(broker), what + why + "; its library stays loaded");
    library_.keep();
  };
  std::promise<bool> outcome;
  std::future<bool> mayUnload = outcome.get_future();
  // On a thread of its own, which ends with the provider's; a promise that nobody keeps says so.
  std::thread cleaner([what, made, broker, outcome = std::move(outcome)]() mutable {
    outcome.set_value(std::apply([&](auto*... mi) { return (clean(what, mi, broker) & ...); }, made));
  });
  if (mayUnload.wait_for(limit) == std::future_status::timeout) {
    cleaner.detach();
    keep(" has not ended after " + std::to_string(limit.count()) + " ms");
    return false;
  }
  cleaner.join();
  try {
    if (!mayUnload.get()) {
      library_.keep();
    }
  } catch (const std::future_error&) {
    keep(" has ended its thread");
  }
  return true;
}

}  // namespace Cimom
