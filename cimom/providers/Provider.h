// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>
#include <cxxabi.h>

#include <chrono>
#include <condition_variable>
#include <exception>
#include <filesystem>
#include <mutex>
#include <string>
#include <tuple>
#include <vector>

#include "cimom/broker/Handle.h"
#include "cimom/broker/ProviderFrame.h"
#include "cimom/providers/ProviderLibrary.h"
#include "cimom/providers/ProviderRegistration.h"

namespace Cimom {

// Throws StatusError for a status that is not OK, and CMPI_RC_ERR_FAILED for a return code that CMPI does not have.
void requireOk(const std::string& what, const CMPIStatus& status);

// Notes, and logs, that a provider ends the thread that it was called on.
void reportThreadEnd(const std::string& what) noexcept;

// Runs a provider's function and turns both its status and what it throws into a StatusError: a provider's failure
// ends its request, never the object manager.
template <typename Call>
void runProvider(const std::string& what, Call call) {
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  try {
    const ProviderFrame frame;
    status = call();
  } catch (const abi::__forced_unwind&) {
    reportThreadEnd(what);
    throw;  // the thread ends, whatever is done here
  } catch (const ThreadExit&) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " tried to end the thread of its request");
  } catch (const std::exception& error) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " threw an exception: " + error.what());
  } catch (...) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " threw an exception of an unknown type");
  }
  requireOk(what, status);
}

// A provider: its library and its management interfaces (MI), each made by its factory when it is first asked for
// and cleaned up once.
class Provider {
 public:
  // How long a factory or a clean-up may take before nobody waits for it any more.
  using Limit = std::chrono::milliseconds;
  static constexpr Limit defaultLimit{5000};

  // A provider in lib<location>.so along `directories`, which must outlive it.
  Provider(std::string name, std::string location, const std::vector<std::filesystem::path>& directories);
  // A provider that is linked into the program.
  Provider(std::string name, ProviderFactories factories);

  // Adds the factories that a linked provider does not have yet.
  void complete(ProviderFactories factories);

  // Cleans up every MI that was made; no call may be under way. What goes wrong is logged, and the library stays loaded
  // then. Returns false if the provider does not end within the limit: it may still use the broker, which has to stay.
  bool cleanUp(const CMPIBroker* broker, Limit limit);

  // CMPIInstanceMI, CMPIAssociationMI or CMPIMethodMI.
  // Throws StatusError CMPI_RC_ERR_FAILED if library, factory or MI cannot be had; the next call tries again. So does a
  // call that comes, by way of up-calls, from a factory while this provider's is at work; another thread's waits.
  template <typename Mi>
  Mi* interface(const CMPIBroker* broker, Limit limit = defaultLimit);
  CMPIInstanceMI* instanceMi(const CMPIBroker* broker) { return interface<CMPIInstanceMI>(broker); }
  CMPIAssociationMI* associationMi(const CMPIBroker* broker) { return interface<CMPIAssociationMI>(broker); }
  CMPIMethodMI* methodMi(const CMPIBroker* broker) { return interface<CMPIMethodMI>(broker); }

  const std::string& name() const { return name_; }
  const std::string& location() const { return location_; }
  bool isLinked() const { return !directories_; }

 private:
  class Turn;

  template <typename Mi>
  ProviderFactory<Mi>& requireFactory(const std::string& factoryName);

  std::string name_;
  std::string location_;
  const std::vector<std::filesystem::path>* directories_ = nullptr;
  std::mutex mutex_;  // of what was made, and of whose turn it is to make more
  std::condition_variable turnEnded_;
  bool isBusy_ = false;
  ProviderLibrary library_;  // this and the factories are used by who has the turn
  ProviderFactories factories_;
  std::tuple<CMPIInstanceMI*, CMPIAssociationMI*, CMPIMethodMI*> made_{};
};

}  // namespace Cimom
