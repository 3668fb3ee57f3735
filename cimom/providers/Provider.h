// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <exception>
#include <filesystem>
#include <mutex>
#include <string>
#include <vector>

#include "cimom/broker/Handle.h"
#include "cimom/providers/ProviderLibrary.h"
#include "cimom/providers/ProviderRegistration.h"

namespace Cimom {

// Runs a provider's function and turns both its status and what it throws into a StatusError: a provider's failure
// ends its request, never the object manager.
template <typename Call>
void runProvider(const std::string& what, Call call) {
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  try {
    status = call();
  } catch (const std::exception& error) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " threw an exception: " + error.what());
  } catch (...) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " threw an exception of an unknown type");
  }
  if (status.rc != CMPI_RC_OK) {
    throw StatusError(status.rc, status.msg && status.msg->hdl ? textOf(status.msg) : "");
  }
}

// A provider: its library and its management interfaces (MI), each made by its factory when it is first asked for
// and cleaned up once.
class Provider {
 public:
  // A provider in lib<location>.so along `directories`, which must outlive it.
  Provider(std::string name, std::string location, const std::vector<std::filesystem::path>& directories);
  // A provider that is linked into the program.
  Provider(std::string name, InstanceFactory instanceFactory, AssociationFactory associationFactory);

  // Adds the factories that a linked provider does not have yet.
  void complete(InstanceFactory instanceFactory, AssociationFactory associationFactory);

  // Cleans up every MI that was made; no call may be under way.
  void cleanUp(const CMPIBroker* broker);

  // Throws StatusError CMPI_RC_ERR_FAILED if library, factory or MI cannot be had; the next call tries again.
  CMPIInstanceMI* instanceMi(const CMPIBroker* broker);
  CMPIAssociationMI* associationMi(const CMPIBroker* broker);

  const std::string& name() const { return name_; }
  const std::string& location() const { return location_; }
  bool isLinked() const { return !directories_; }

 private:
  template <typename Mi>
  using Factory = std::function<Mi*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>;

  template <typename Mi>
  Mi* make(Mi*& mi, Factory<Mi>& factory, const char* kind, const CMPIBroker* broker);

  std::string name_;
  std::string location_;
  const std::vector<std::filesystem::path>* directories_ = nullptr;
  ProviderLibrary library_;
  std::mutex mutex_;
  InstanceFactory instanceFactory_;
  AssociationFactory associationFactory_;
  CMPIInstanceMI* instanceMi_ = nullptr;
  CMPIAssociationMI* associationMi_ = nullptr;
};

}  // namespace Cimom
