#include "AssociationBuilder.h"

#include <Trace.h>

#include <cstring>
#include <optional>

#include "CmpiAccess.h"

namespace QV::IPConfigComposite {

namespace {

// One run of a builder. Its members answer with the result to end with, or nothing to go on.
class Run {
 public:
  Run(const AssociationBuilder& builder, const CMPIBroker* broker, const CMPIObjectPath* ref, const char** properties,
      const CMPIContext* ctx, std::vector<CMPIInstance*>& out)
      : builder_(builder),
        frame_(builder.component, builder.file, builder.function),
        broker_(broker),
        ref_(ref),
        properties_(properties),
        ctx_(ctx),
        out_(out) {}

  int run() {
    frame_.markEntry(builder_.entryLine);
    std::vector<CMPIInstance*> outers;
    if (!read(builder_.outer, outers)) {
      // An outer end that cannot be read always ends the run.
      return *react(builder_.outerFailed);
    }
    for (std::uint16_t i = 0; i < countOf(outers); ++i) {
      if (const std::optional<int> result = pairWithInners(outers.at(i))) {
        return *result;
      }
    }
    frame_.markExit(builder_.exitLine);
    return 0;
  }

 private:
  std::optional<int> react(const Reaction& reaction) {
    if (reaction.message != nullptr) {
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

  bool read(const End& end, std::vector<CMPIInstance*>& instances) {
    IPConfigObjectFactory factory;
    return (factory.*end.getAll)(broker_, ctx_, ref_, end.className, nullptr, false, instances, &status_) == 0;
  }

  std::optional<int> pairWithInners(const CMPIInstance* outer) {
    if (CMIsNullObject(outer)) {
      return react(builder_.outerNull);
    }
    CMPIObjectPath* const outerPath = pathOf(outer, &status_);
    if (CMIsNullObject(outerPath)) {
      return std::nullopt;
    }
    rehome(outerPath, ref_, &status_);
    if (builder_.outerIdentifierRead) {
      keyOf(outerPath, "InstanceID", &status_);
    }
    std::vector<CMPIInstance*> inners;
    if (!read(builder_.inner, inners)) {
      return react(builder_.innerFailed);
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
      return react(builder_.innerNull);
    }
    CMPIObjectPath* const innerPath = pathOf(inner, &status_);
    if (CMIsNullObject(innerPath)) {
      return std::nullopt;
    }
    rehome(innerPath, ref_, &status_);
    if (builder_.innerMarker != nullptr && std::strstr(identifierOf(innerPath), builder_.innerMarker) == nullptr) {
      return std::nullopt;
    }

    CMPIObjectPath* const path =
        CMNewObjectPath(broker_, nameSpaceOf(ref_, &status_), builder_.associationClass, &status_);
    if (CMIsNullObject(path)) {
      return react(builder_.pathFailed);
    }
    rehome(path, ref_, &status_);
    const CMPIObjectPath* const firstPath = builder_.firstIsOuter ? outerPath : innerPath;
    const CMPIObjectPath* const secondPath = builder_.firstIsOuter ? innerPath : outerPath;
    if (builder_.keysOnPath) {
      CMAddKey(path, builder_.first, &firstPath, CMPI_ref);
      CMAddKey(path, builder_.second, &secondPath, CMPI_ref);
    }

    CMPIInstance* const instance = CMNewInstance(broker_, path, nullptr);
    if (CMIsNullObject(instance)) {
      if (builder_.instanceFailed == UnmadeInstance::Append) {
        out_.push_back(instance);
      }
      return std::nullopt;
    }
    const char* keys[] = {builder_.first, builder_.second, nullptr};
    CMSetPropertyFilter(instance, properties_, keys);
    setReference(instance, builder_.first, firstPath);
    setReference(instance, builder_.second, secondPath);
    if (builder_.settingFlags) {
      setSettingFlags(instance, innerPath);
    }
    out_.push_back(instance);
    return std::nullopt;
  }

  const char* identifierOf(const CMPIObjectPath* path) { return textOf(keyOf(path, "InstanceID", &status_), &status_); }

  // Nothing where the read or the conversion to characters left an error, even with a value beside it.
  std::optional<std::string> readableIdentifierOf(const CMPIObjectPath* path) {
    CMPIStatus read = {CMPI_RC_OK, nullptr};
    CMPIStatus conversion = {CMPI_RC_OK, nullptr};
    const std::string identifier = textOf(keyOf(path, "InstanceID", &read), &conversion);
    if (read.rc != CMPI_RC_OK || conversion.rc != CMPI_RC_OK) {
      return std::nullopt;
    }
    return identifier;
  }

  // The values of CIM_ElementSettingData: 1 "Is Default"/"Is Current", 2 "Is Not …", 3 "Is Next For Single Use".
  void setSettingFlags(CMPIInstance* instance, const CMPIObjectPath* sequencePath) {
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

  const AssociationBuilder& builder_;
  const Frame frame_;
  const CMPIBroker* broker_;
  const CMPIObjectPath* ref_;
  const char** properties_;
  const CMPIContext* ctx_;
  std::vector<CMPIInstance*>& out_;
  CMPIStatus status_ = {CMPI_RC_OK, nullptr};
};

}  // namespace

int buildAssociations(const AssociationBuilder& builder, const CMPIBroker* broker, const CMPIObjectPath* ref,
                      const char** properties, const CMPIContext* ctx, std::vector<CMPIInstance*>& out) {
  return Run(builder, broker, ref, properties, ctx, out).run();
}

}  // namespace QV::IPConfigComposite
