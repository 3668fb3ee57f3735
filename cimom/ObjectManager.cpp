// SPDX-License-Identifier: Apache-2.0
#include "cimom/ObjectManager.h"

#include "cimom/broker/BrokerCore.h"
#include "cimom/schema/Mof.h"

namespace Cimom {

struct ObjectManager::Parts {
  Parts() { core.operations = &router; }

  MofReader reader;
  BrokerCore core;
  // Ends first: a provider may still make up-calls while it is cleaned up.
  Router router{&core.broker};

  void showClass(const ProviderRegistration& registration) {
    for (const std::string& nameSpace : registration.namespaces) {
      core.classes.show(nameSpace, registration.className);
    }
  }
};

ObjectManager::ObjectManager() : parts_(std::make_unique<Parts>()) {}

ObjectManager::~ObjectManager() {
  if (!parts_->router.providers().cleanUp()) {
    [[maybe_unused]] const Parts* stays = parts_.release();
  }
}

void ObjectManager::loadSchema(const std::filesystem::path& fileOrDirectory) {
  parts_->core.classes.add(parts_->reader.readPath(fileOrDirectory));
}

void ObjectManager::loadSchemaText(std::string_view mof, std::string_view nameSpace, std::string_view origin) {
  const MofDeclarations declarations = parts_->reader.readText(mof, std::string(origin));
  parts_->core.classes.add(declarations);
  parts_->core.classes.addNamespace(nameSpace);
  for (const ClassDeclaration& declaration : declarations.classes) {
    if (declaration.nameSpace.empty()) {
      parts_->core.classes.show(nameSpace, declaration.own.name);
    }
  }
}

void ObjectManager::showSchema(std::string_view nameSpace) { parts_->core.classes.showSchema(nameSpace); }

void ObjectManager::loadRegistration(const std::filesystem::path& fileOrDirectory) {
  for (const ProviderRegistration& registration : readRegistration(fileOrDirectory)) {
    parts_->router.providers().add(registration);
    parts_->showClass(registration);
  }
}

void ObjectManager::addProviderDirectory(const std::filesystem::path& directory) {
  parts_->router.providers().addDirectory(directory);
}

void ObjectManager::addProvider(const ProviderRegistration& registration, InstanceFactory instanceFactory,
                                AssociationFactory associationFactory, MethodFactory methodFactory) {
  parts_->router.providers().add(registration,
                                 {std::move(instanceFactory), std::move(associationFactory), std::move(methodFactory)});
  parts_->showClass(registration);
}

void ObjectManager::setProviderLimit(std::chrono::milliseconds limit) { parts_->router.providers().setLimit(limit); }

void ObjectManager::checkProviders() {
  for (const auto& [registration, provider] : parts_->router.providers().entries()) {
    for (const std::string& nameSpace : registration.namespaces) {
      if (parts_->core.classes.find(nameSpace, registration.className)) {
        continue;
      }
      const bool elsewhere = parts_->core.classes.find(registration.className) != nullptr;
      throw ConfigurationError(
          (registration.registeredAt.empty() ? "" : registration.registeredAt + ": ") + "class " +
          registration.className +
          (elsewhere ? " is declared for another namespace than " + nameSpace : " is not in the schema"));
    }
  }
  parts_->router.providers().load();
}

void ObjectManager::setStrictness(Strictness strictness) { parts_->router.setStrictness(strictness); }

void ObjectManager::setLog(MessageSink sink) { parts_->core.log = std::move(sink); }

void ObjectManager::setTrace(MessageSink sink) { parts_->core.trace = std::move(sink); }

const CMPIBroker* ObjectManager::broker() const { return &parts_->core.broker; }

const ClassRepository& ObjectManager::classes() const { return parts_->core.classes; }

}  // namespace Cimom
