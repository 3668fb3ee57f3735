// SPDX-License-Identifier: Apache-2.0
#include "cimom/providers/ProviderRegistry.h"

#include <algorithm>

#include "cimom/broker/BrokerCore.h"
#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"

namespace Cimom {

bool ProviderRegistry::Entry::serves(std::string_view nameSpace) const {
  return std::ranges::any_of(registration.namespaces, [&](const std::string& one) {
    return sameName(bareNamespace(one), bareNamespace(nameSpace));
  });
}

bool ProviderRegistry::cleanUp() {
  bool allEnded = true;
  std::for_each(providers_.rbegin(), providers_.rend(),
                [&](const auto& provider) { allEnded = provider->cleanUp(broker_, limit_) && allEnded; });
  return allEnded;
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

void ProviderRegistry::add(const ProviderRegistration& registration, ProviderFactories factories) {
  const auto known = std::ranges::find_if(providers_, [&](const auto& provider) {
    return provider->isLinked() && provider->name() == registration.provider;
  });
  if (known != providers_.end()) {
    (*known)->complete(std::move(factories));
    return addEntry(registration, known->get());
  }
  auto provider = std::make_unique<Provider>(registration.provider, std::move(factories));
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
  std::vector<std::string> failures;  // one of a kind for each provider
  std::size_t made = 0;
  const auto make = [&](const Entry& entry, bool isRegistered, auto interface) {
    if (!isRegistered) {
      return;
    }
    try {
      (entry.provider->*interface)(broker_, limit_);
      ++made;
    } catch (const StatusError& error) {
      const std::string& place = entry.registration.registeredAt;
      const std::string what = "provider " + entry.registration.provider + ": " + error.what();
      if (std::ranges::none_of(failures, [&](const std::string& one) { return one.ends_with(what); })) {
        failures.push_back((place.empty() ? "" : place + ": ") + what);
      }
    }
  };
  for (const Entry& entry : entries_) {
    make(entry, entry.registration.instance, &Provider::interface<CMPIInstanceMI>);
    make(entry, entry.registration.association, &Provider::interface<CMPIAssociationMI>);
    make(entry, entry.registration.method, &Provider::interface<CMPIMethodMI>);
  }
  if (made == 0 && !failures.empty()) {
    throw ConfigurationError(failures.front());
  }
  for (const std::string& failure : failures) {
    logError(coreOf(broker_), failure + "; its classes fail until it can be had");
  }
}

}  // namespace Cimom
