// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/PersonalBroker.h"

#include <cmpimacs.h>

#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Guard.h"
#include "tests/support/broker/PersonalObjects.h"
#include "tests/support/broker/Personality.h"

namespace Testing {

namespace {

PersonalBroker* current = nullptr;

// The class as the broker knows it; null if it does not.
const Cimom::ClassDefinition* classOf(const CMPIBroker* broker, const char* name) {
  return !name || current->unknownClasses.contains(name) ? nullptr : Cimom::coreOf(broker).classes.find(name);
}

}  // namespace

PersonalBroker::PersonalBroker(const CMPIBroker* real)
    : broker_(*real), upCallTable_(*real->bft), encapsulation_(*real->eft) {
  upCallTable_.brokerVersion = personality().brokerVersion;
  encapsulation_.ftVersion = personality().tableVersion;
  encapsulation_.newObjectPath = newObjectPath;
  encapsulation_.newInstance = newInstance;
  encapsulation_.newString = newString;
  encapsulation_.trace = trace;
  if (!personality().hasCmpi2Slots) {
    encapsulation_.newCMPIError = nullptr;
    encapsulation_.openMessageFile = nullptr;
    encapsulation_.closeMessageFile = nullptr;
    encapsulation_.getMessage2 = nullptr;
  }
  broker_.bft = &upCallTable_;
  broker_.eft = &encapsulation_;
  if (!personality().hasMemoryServices) {
    broker_.mft = nullptr;
  }
  current = this;
}

PersonalBroker::~PersonalBroker() {
  forgetInstances();
  current = nullptr;
}

CMPIObjectPath* PersonalBroker::newObjectPath(const CMPIBroker* broker, const char* nameSpace, const char* className,
                                              CMPIStatus* status) {
  const Cimom::ClassDefinition* definition = classOf(broker, className);
  CMPIObjectPath* path = Cimom::encapsulationTable.newObjectPath(broker, nameSpace, className, status);
  personalize(status);
  if (path && definition && personality().countsUnsetKeys) {
    addUnsetKeys(Cimom::ownModelOf<Cimom::ObjectPath>(path), *definition);
  }
  return personal(path);
}

CMPIInstance* PersonalBroker::newInstance(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* status) {
  if (CMIsNullObject(path)) {
    return Cimom::encapsulationTable.newInstance(broker, path, status);
  }
  const auto& given = Cimom::modelOf<Cimom::ObjectPath>(path);
  if (!classOf(broker, given.className.c_str())) {
    const bool made = personality().unknownClass != UnknownClass::HasNoInstance;
    if (status) {
      *status = {made ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_CLASS, nullptr};
    }
    return made ? instanceOfUnknownClass(given) : nullptr;
  }
  const auto kept = Cimom::lend(personality().instancesKeepTheirHost ? given : withoutHost(given));
  CMPIInstance* instance = personal(Cimom::encapsulationTable.newInstance(broker, &kept, status));
  personalize(status);
  if (instance) {
    keepUndeclaredKeys(instance, given);
  }
  return instance;
}

CMPIString* PersonalBroker::newString(const CMPIBroker* broker, const char* characters, CMPIStatus* status) {
  CMPIString* string = Cimom::encapsulationTable.newString(broker, characters, status);
  personalize(status);
  return personal(string);
}

CMPIStatus PersonalBroker::trace(const CMPIBroker* broker, Cmpi::TraceLevel level, const char* component,
                                 const char* text, const CMPIString* string) {
  if (personality().traceCode != CMPI_RC_OK) {
    return {personality().traceCode, nullptr};
  }
  return Cimom::encapsulationTable.trace(broker, level, component, text, string);
}

}  // namespace Testing
