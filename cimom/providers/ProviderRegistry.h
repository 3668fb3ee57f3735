// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <memory>
#include <string_view>
#include <vector>

#include "cimom/providers/Provider.h"
#include "cimom/providers/ProviderRegistration.h"

namespace Cimom {

// Which provider serves which class in which namespace.
class ProviderRegistry {
 public:
  struct Entry {
    ProviderRegistration registration;
    Provider* provider;

    bool serves(std::string_view nameSpace) const;
  };

  explicit ProviderRegistry(const CMPIBroker* broker) : broker_(broker) {}
  ~ProviderRegistry();
  ProviderRegistry(const ProviderRegistry&) = delete;
  ProviderRegistry& operator=(const ProviderRegistry&) = delete;

  void addDirectory(const std::filesystem::path& directory) { directories_.push_back(directory); }

  // Throws ConfigurationError if the class has a provider in that namespace already.
  void add(const ProviderRegistration& registration);
  void add(const ProviderRegistration& registration, InstanceFactory instanceFactory,
           AssociationFactory associationFactory);

  // Every registered class, in the order of registration.
  const std::vector<Entry>& entries() const { return entries_; }

  // Makes every management interface now.
  // Throws ConfigurationError for the first one that cannot be had.
  void load() const;

 private:
  void addEntry(const ProviderRegistration& registration, Provider* provider);

  const CMPIBroker* broker_;
  std::vector<std::filesystem::path> directories_;
  std::vector<std::unique_ptr<Provider>> providers_;
  std::vector<Entry> entries_;
};

}  // namespace Cimom
