// SPDX-License-Identifier: Apache-2.0
#include "cimom/providers/Provider.h"

namespace Cimom {

Provider::Provider(std::string name, std::string location, const std::vector<std::filesystem::path>& directories)
    : name_(std::move(name)), location_(std::move(location)), directories_(&directories) {}

Provider::Provider(std::string name, InstanceFactory instanceFactory, AssociationFactory associationFactory)
    : name_(std::move(name)),
      instanceFactory_(std::move(instanceFactory)),
      associationFactory_(std::move(associationFactory)) {}

void Provider::complete(InstanceFactory instanceFactory, AssociationFactory associationFactory) {
  if (!instanceFactory_) {
    instanceFactory_ = std::move(instanceFactory);
  }
  if (!associationFactory_) {
    associationFactory_ = std::move(associationFactory);
  }
}

CMPIInstanceMI* Provider::instanceMi(const CMPIBroker* broker) {
  return make(instanceMi_, instanceFactory_, "Instance", broker);
}

CMPIAssociationMI* Provider::associationMi(const CMPIBroker* broker) {
  return make(associationMi_, associationFactory_, "Association", broker);
}

template <typename Mi>
Mi* Provider::make(Mi*& mi, Factory<Mi>& factory, const char* kind, const CMPIBroker* broker) {
  const std::lock_guard lock(mutex_);
  if (mi) {
    return mi;
  }
  const std::string factoryName = name_ + "_Create_" + kind + "MI";
  if (!factory) {
    if (isLinked()) {
      throw StatusError(CMPI_RC_ERR_FAILED, "provider " + name_ + " has no " + factoryName);
    }
    if (!library_) {
      library_ = ProviderLibrary(location_, *directories_);
    }
    factory = library_.function<Mi*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>(factoryName);
  }
  RequestScope scope(broker);
  Mi* made = nullptr;
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  runProvider(factoryName, [&] {
    made = factory(broker, scope.context(), &status);
    return status;
  });
  if (!made || !made->ft) {
    throw StatusError(CMPI_RC_ERR_FAILED, factoryName + " returned no management interface");
  }
  return mi = made;
}

void Provider::cleanUp(const CMPIBroker* broker) {
  const auto clean = [&](auto*& mi) {
    if (!mi) {
      return;
    }
    RequestScope scope(broker);
    constexpr CMPIBoolean terminating = true;
    const CMPIStatus status = mi->ft->cleanup ? mi->ft->cleanup(mi, scope.context(), terminating) : CMPIStatus{};
    // The provider knows of something that still runs in its code.
    if (status.rc == CMPI_RC_DO_NOT_UNLOAD || status.rc == CMPI_RC_NEVER_UNLOAD) {
      library_.keep();
    }
    mi = nullptr;
  };
  clean(instanceMi_);
  clean(associationMi_);
}

}  // namespace Cimom
