// SPDX-License-Identifier: Apache-2.0
#include "cimom/providers/ProviderRegistry.h"

#include <algorithm>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"

namespace Cimom {

bool ProviderRegistry::Entry::serves(std::string_view nameSpace) const {
  return std::ranges::any_of(registration.namespaces, [&](const std::string& one) {
    return sameName(bareNamespace(one), bareNamespace(nameSpace));
  });
}

ProviderRegistry::~ProviderRegistry() {
  std::for_each(providers_.rbegin(), providers_.rend(), [&](const auto& provider) { provider->cleanUp(broker_); });
}

void ProviderRegistry::add(const ProviderRegistration& registration) {
  const auto known = std::ranges::find_if(providers_, [&](const auto& provider) {
    return !provider->isLinked() && provider->name() == registration.provider &&
           provider->location() == registration.location;
  });
  if (known != providers_.end()) {
    return addEntry(registration, known->get());
  }
  auto provider = std::make_unique<Provider>(registration.provider, registration.location, directories_);
  addEntry(registration, provider.get());
  providers_.push_back(std::move(provider));
}

void ProviderRegistry::add(const ProviderRegistration& registration, InstanceFactory instanceFactory,
                           AssociationFactory associationFactory) {
  const auto known = std::ranges::find_if(providers_, [&](const auto& provider) {
    return provider->isLinked() && provider->name() == registration.provider;
  });
  if (known != providers_.end()) {
    (*known)->complete(std::move(instanceFactory), std::move(associationFactory));
    return addEntry(registration, known->get());
  }
  auto provider =
      std::make_unique<Provider>(registration.provider, std::move(instanceFactory), std::move(associationFactory));
  addEntry(registration, provider.get());
  providers_.push_back(std::move(provider));
}

void ProviderRegistry::addEntry(const ProviderRegistration& registration, Provider* provider) {
  for (const Entry& entry : entries_) {
    if (!sameName(entry.registration.className, registration.className)) {
      continue;
    }
    for (const std::string& nameSpace : registration.namespaces) {
      if (!entry.serves(nameSpace)) {
        continue;
      }
      throw ConfigurationError(
          (registration.registeredAt.empty() ? "" : registration.registeredAt + ": ") + "class " +
          registration.className + " already has a provider in " + nameSpace +
          (entry.registration.registeredAt.empty() ? "" : ", registered at " + entry.registration.registeredAt));
    }
  }
  entries_.push_back({registration, provider});
}

void ProviderRegistry::load() const {
  for (const auto& [registration, provider] : entries_) {
    try {
      if (registration.instance) {
        provider->instanceMi(broker_);
      }
      if (registration.association) {
        provider->associationMi(broker_);
      }
    } catch (const StatusError& error) {
      throw ConfigurationError((registration.registeredAt.empty() ? "" : registration.registeredAt + ": ") +
                               "provider " + registration.provider + ": " + error.what());
    }
  }
}

}  // namespace Cimom
