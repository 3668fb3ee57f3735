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
  ProviderRegistry(const ProviderRegistry&) = delete;
  ProviderRegistry& operator=(const ProviderRegistry&) = delete;

  void addDirectory(const std::filesystem::path& directory) { directories_.push_back(directory); }

  // Throws ConfigurationError if the class has a provider in that namespace already.
  void add(const ProviderRegistration& registration);
  void add(const ProviderRegistration& registration, ProviderFactories factories);

  // Every registered class, in the order of registration.
  const std::vector<Entry>& entries() const { return entries_; }

  // How long a factory or a clean-up may take.
  void setLimit(Provider::Limit limit) { limit_ = limit; }

  // Makes every management interface now, and logs those that cannot be had.
  // Throws ConfigurationError for the first of them if there is no other.
  void load() const;

  // Cleans all providers up, the last one first. Returns false if one of them does not end.
  bool cleanUp();

 private:
  void addEntry(const ProviderRegistration& registration, Provider* provider);

  const CMPIBroker* broker_;
  Provider::Limit limit_ = Provider::defaultLimit;
  std::vector<std::filesystem::path> directories_;
  std::vector<std::unique_ptr<Provider>> providers_;
  std::vector<Entry> entries_;
};

}  // namespace Cimom
