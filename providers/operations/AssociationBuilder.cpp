// SPDX-License-Identifier: Apache-2.0
// The builders of association instances: each pairs the composite instances of an association's two ends.
#include <cstring>
#include <optional>

#include "factory/CmpiAccess.h"
#include "providers/operations/AssociationOperations.h"
#include "trace/Trace.h"

namespace QV::IPConfigComposite {

namespace {

// One run of a builder. Its members return the result to end with, or nothing to go on.
class Run {
 public:
  Run(const AssociationUnit& unit, const CMPIBroker* broker, const CMPIObjectPath* ref, const char** properties,
      const CMPIContext* ctx, std::vector<CMPIInstance*>& out)
      : unit_(unit),
        pairing_(unit.pairing),
        frame_(unit.trace.component, unit.trace.file, unit.trace.builder),
        broker_(broker),
        ref_(ref),
        properties_(properties),
        ctx_(ctx),
        out_(out) {}

  int run() {
    frame_.markEntry(unit_.trace.builderEntryLine);
    std::vector<CMPIInstance*> outers;
    if (!read(pairing_.outer, outers)) {
      // An outer end that cannot be read always ends the run.
      return *react(unit_.onFailure.outerUnreadable);
    }
    for (std::uint16_t i = 0; i < countOf(outers); ++i) {
      if (const std::optional<int> result = pairWithInners(outers.at(i))) {
        return *result;
      }
    }
    frame_.markExit(unit_.trace.builderExitLine);
    return 0;
  }

 private:
  std::optional<int> react(const Reaction& reaction) {
    if (reaction.message) {
      frame_.failure(reaction.message, reaction.line);
    }
    switch (reaction.course) {
      case Reaction::Course::EndWith0:
        return 0;
      case Reaction::Course::EndWith1:
        return 1;
      case Reaction::Course::GoOn:
        break;
    }
    return std::nullopt;
  }

  bool read(End end, std::vector<CMPIInstance*>& instances) {
    const CompositeClass& composite = unit_.association.classAt(end);
    IPConfigObjectFactory factory;
    return (factory.*composite.getAll)(broker_, ctx_, ref_, composite.name, nullptr, false, instances, &status_) == 0;
  }

  std::optional<int> pairWithInners(const CMPIInstance* outer) {
    if (CMIsNullObject(outer)) {
      return react(unit_.onFailure.outerUnusable);
    }
    CMPIObjectPath* outerPath = pathOf(outer, &status_);
    if (CMIsNullObject(outerPath)) {
      return std::nullopt;
    }
    rehome(outerPath, ref_, &status_);
    if (pairing_.readsOuterIdentifier) {
      keyOf(outerPath, "InstanceID", &status_);
    }
    std::vector<CMPIInstance*> inners;
    if (!read(otherThan(pairing_.outer), inners)) {
      return react(unit_.onFailure.innerUnreadable);
    }
    for (std::uint16_t i = 0; i < countOf(inners); ++i) {
      if (const std::optional<int> result = pair(outerPath, inners.at(i))) {
        return result;
      }
    }
    return std::nullopt;
  }

  std::optional<int> pair(const CMPIObjectPath* outerPath, const CMPIInstance* inner) {
    if (CMIsNullObject(inner)) {
      return react(unit_.onFailure.innerUnusable);
    }
    CMPIObjectPath* innerPath = pathOf(inner, &status_);
    if (CMIsNullObject(innerPath)) {
      return std::nullopt;
    }
    rehome(innerPath, ref_, &status_);
    if (!contains(innerPath, pairing_.wordInInnerIdentifier)) {
      return std::nullopt;
    }

    CMPIObjectPath* path = CMNewObjectPath(broker_, nameSpaceOf(ref_, &status_), unit_.association.name, &status_);
    if (CMIsNullObject(path)) {
      return react(unit_.onFailure.pathUnmade);
    }
    rehome(path, ref_, &status_);
    const auto& [first, second] = unit_.association.referencesOfInstance;
    const CMPIObjectPath* firstPath = first.end == pairing_.outer ? outerPath : innerPath;
    const CMPIObjectPath* secondPath = second.end == pairing_.outer ? outerPath : innerPath;
    if (pairing_.referencesAreKeys) {
      CMAddKey(path, first.name, &firstPath, CMPI_ref);
      CMAddKey(path, second.name, &secondPath, CMPI_ref);
    }

    CMPIInstance* instance = CMNewInstance(broker_, path, nullptr);
    if (CMIsNullObject(instance)) {
      if (unit_.onFailure.instanceUnmade == UnmadeInstance::Append) {
        out_.push_back(instance);
      }
      return std::nullopt;
    }
    const char* keys[] = {first.name, second.name, nullptr};
    CMSetPropertyFilter(instance, properties_, keys);
    setReference(instance, first.name, firstPath);
    setReference(instance, second.name, secondPath);
    if (pairing_.setsDefaultCurrentNext) {
      setDefaultCurrentNext(instance, innerPath);
    }
    out_.push_back(instance);
    return std::nullopt;
  }

  // Reads the identifier only for a word that must be there.
  bool contains(const CMPIObjectPath* path, const char* word) {
    return *word == '\0' || std::strstr(textOf(keyOf(path, "InstanceID", &status_), &status_), word);
  }

  // Nothing if the read or the conversion to characters left an error, even with a value beside it.
  static std::optional<std::string> readableIdentifierOf(const CMPIObjectPath* path) {
    CMPIStatus read = {CMPI_RC_OK, nullptr};
    CMPIStatus conversion = {CMPI_RC_OK, nullptr};
    const std::string identifier = textOf(keyOf(path, "InstanceID", &read), &conversion);
    if (read.rc != CMPI_RC_OK || conversion.rc != CMPI_RC_OK) {
      return std::nullopt;
    }
    return identifier;
  }

  // The values of CIM_ElementSettingData: 1 "Is Default"/"Is Current", 2 "Is Not …", 3 "Is Next For Single Use".
  static void setDefaultCurrentNext(CMPIInstance* instance, const CMPIObjectPath* sequencePath) {
    std::vector<std::string> fields;
    if (const std::optional<std::string> identifier = readableIdentifierOf(sequencePath)) {
      IPConfigObjectFactory().Tokenize(*identifier, fields, ":");
    }
    const CMPIUint16 isInForce = fields.size() > 2 ? 2 : 1;
    const CMPIUint16 isNext = 3;
    CMSetProperty(instance, "IsDefault", &isInForce, CMPI_uint16);
    CMSetProperty(instance, "IsCurrent", &isInForce, CMPI_uint16);
    CMSetProperty(instance, "IsNext", &isNext, CMPI_uint16);
  }

  const AssociationUnit& unit_;
  const AssociationUnit::Pairing& pairing_;
  const Frame frame_;
  const CMPIBroker* broker_;
  const CMPIObjectPath* ref_;
  const char** properties_;
  const CMPIContext* ctx_;
  std::vector<CMPIInstance*>& out_;
  CMPIStatus status_ = {CMPI_RC_OK, nullptr};
};

}  // namespace

int buildAssociations(const AssociationUnit& unit, const CMPIBroker* broker, const CMPIObjectPath* ref,
                      const char** properties, const CMPIContext* ctx, std::vector<CMPIInstance*>& out) {
  return Run(unit, broker, ref, properties, ctx, out).run();
}

}  // namespace QV::IPConfigComposite
