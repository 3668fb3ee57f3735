#ifndef CIMOM_REGISTRY_PROVIDER_H_
#define CIMOM_REGISTRY_PROVIDER_H_

#include <cmpift.h>

#include <filesystem>
#include <mutex>
#include <string>
#include <vector>

#include "cimom/providers/ProviderLibrary.h"
#include "cimom/providers/ProviderRegistration.h"

namespace Cimom {

/// A provider: its library and its management interfaces (MI), each made by its factory when it is first asked for
/// and cleaned up once.
class Provider {
 public:
  /// A provider in lib<location>.so along `directories`, which must outlive it.
  Provider(std::string name, std::string location, const std::vector<std::filesystem::path>& directories);
  /// A provider that is linked into the program.
  Provider(std::string name, InstanceFactory instanceFactory, AssociationFactory associationFactory);

  /// Gives a linked provider the factories that it does not have yet.
  void complete(InstanceFactory instanceFactory, AssociationFactory associationFactory);

  /// Cleans up every MI that was made; no call may be under way.
  void cleanUp(const CMPIBroker* broker);

  /// @throws StatusError CMPI_RC_ERR_FAILED where library, factory or MI cannot be had; the next call tries again
  CMPIInstanceMI* instanceMi(const CMPIBroker* broker);
  CMPIAssociationMI* associationMi(const CMPIBroker* broker);

  const std::string& name() const { return name_; }
  const std::string& location() const { return location_; }
  bool isLinked() const { return !directories_; }

 private:
  template <class Mi>
  using Factory = std::function<Mi*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>;

  template <class Mi>
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

#endif  // CIMOM_REGISTRY_PROVIDER_H_
