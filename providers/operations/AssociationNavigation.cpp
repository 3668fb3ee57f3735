// SPDX-License-Identifier: Apache-2.0
// The association side: from a source object to what lies at the far end.
#include <optional>

#include "factory/CmpiAccess.h"
#include "providers/operations/AssociationOperations.h"
#include "trace/Trace.h"

namespace QV::IPConfigComposite {

namespace {

// Everything that the four operations do alike; each brings what it does with one far-end instance.
class Navigation {
 public:
  Navigation(const AssociationCall& call, const CMPIContext* ctx, const CMPIObjectPath* op)
      : unit_(call.unit),
        frame_(call.unit.trace.component, call.unit.trace.file, call.function),
        broker_(call.broker),
        ctx_(ctx),
        op_(op) {
    frame_.markEntry();
    if (unit_.wordInSequence) {
      sourceIdentifier_ = textOf(keyOf(op_, "InstanceID", &status_), &status_);
    }
  }

  // Finds the class at the far end; false if the model has none.
  bool resolve(const char* assocClass, const char* resultClass) {
    target_ = IPConfigObjectFactory().get_assoc_targetClass_ObjectPath(broker_, op_, assocClass, resultClass, &status_);
    return !CMIsNullObject(target_);
  }

  CMPIStatus fail(const char* message) {
    frame_.failure(message);
    return status_;
  }

  // Hands every associated far-end instance to `visit`. A far end that cannot be read ends the operation without the
  // exit marker (compatibility 12).
  template <typename Visit>
  CMPIStatus forEachAssociated(const char* wordInSequence, Visit visit) {
    farEnd_ = endOf(classNameOf(target_, &status_));
    if (farEnd_) {
      const CompositeClass& composite = unit_.association.classAt(*farEnd_);
      std::vector<CMPIInstance*> instances;
      IPConfigObjectFactory factory;
      if ((factory.*composite.getAll)(broker_, ctx_, op_, composite.name, nullptr, false, instances, &status_) != 0) {
        return status_;
      }
      for (std::uint16_t i = 0; i < countOf(instances); ++i) {
        if (isAssociated(instances.at(i), wordInSequence)) {
          visit(instances.at(i));
        }
      }
    }
    frame_.markExit();
    return status_;
  }

  // The keyless path that all association instances of one call are made on.
  void makeAssociationPath() {
    associationPath_ = CMNewObjectPath(broker_, nameSpaceOf(op_, &status_), unit_.association.name, &status_);
  }

  // What ties the source to one far-end instance.
  struct ReferenceInstance {
    CMPIInstance* instance;  // null if it could not be made
    bool hasFarEnd;          // whether the far-end instance has a path to refer to
  };

  // A new association instance between the source, its path as received, and a far-end instance.
  ReferenceInstance makeReference(const CMPIInstance* farInstance) {
    CMPIInstance* instance =
        CMIsNullObject(associationPath_) ? nullptr : CMNewInstance(broker_, associationPath_, &status_);
    const CMPIObjectPath* farPath = rehomedPathOf(farInstance);
    for (const Reference& reference : unit_.association.references) {
      setReference(instance, reference.name, reference.end == farEnd_ ? farPath : op_);
    }
    return {instance, farPath != nullptr};
  }

  // Null if it has none that can be used.
  CMPIObjectPath* rehomedPathOf(const CMPIInstance* instance) {
    CMPIObjectPath* path = pathOf(instance, &status_);
    if (CMIsNullObject(path)) {
      return nullptr;
    }
    rehome(path, op_, &status_);
    return path;
  }

 private:
  // The end whose class has exactly that name (compatibility 22).
  std::optional<End> endOf(const std::string& className) const {
    for (const End end : {End::A, End::B}) {
      if (className == unit_.association.classAt(end).name) {
        return end;
      }
    }
    return std::nullopt;
  }

  bool isAssociated(const CMPIInstance* farInstance, const char* wordInSequence) {
    if (!unit_.wordInSequence) {
      return true;
    }
    const std::string identifier = textOf(propertyOf(farInstance, "InstanceID", &status_), &status_);
    if (identifier.empty()) {
      return false;
    }
    if (farEnd_ == sequenceEnd) {
      return identifier.find(sourceIdentifier_) != std::string::npos &&
             identifier.find(wordInSequence) != std::string::npos;
    }
    // compatibility 26: towards the settings no word is asked for.
    return sourceIdentifier_.find(identifier) != std::string::npos;
  }

  // Where identifiers decide, the sequence is this end and the setting the other.
  static constexpr End sequenceEnd = End::A;

  const AssociationUnit& unit_;
  const Frame frame_;
  const CMPIBroker* broker_;
  const CMPIContext* ctx_;
  const CMPIObjectPath* op_;
  CMPIStatus status_ = {CMPI_RC_OK, nullptr};
  std::string sourceIdentifier_;
  const CMPIObjectPath* target_ = nullptr;
  const CMPIObjectPath* associationPath_ = nullptr;
  std::optional<End> farEnd_;
};

const char* wordOf(const AssociationUnit& unit, const char* WordInSequence::*operation) {
  return unit.wordInSequence ? unit.wordInSequence->*operation : nullptr;
}

}  // namespace

CMPIStatus associators(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char* assocClass, const char* resultClass) {
  Navigation navigation(call, ctx, op);
  if (!navigation.resolve(assocClass, resultClass)) {
    return navigation.fail("Object Path is NULL in Associators.");
  }
  return navigation.forEachAssociated(wordOf(call.unit, &WordInSequence::associators),
                                      [&](const CMPIInstance* instance) { CMReturnInstance(rslt, instance); });
}

CMPIStatus associatorNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                           const CMPIObjectPath* op, const char* assocClass, const char* resultClass) {
  Navigation navigation(call, ctx, op);
  if (!navigation.resolve(assocClass, resultClass)) {
    return navigation.fail("Object Path is NULL in AssociatorNames.");
  }
  return navigation.forEachAssociated(wordOf(call.unit, &WordInSequence::associatorNames),
                                      [&](const CMPIInstance* instance) {
                                        if (const CMPIObjectPath* path = navigation.rehomedPathOf(instance)) {
                                          CMReturnObjectPath(rslt, path);
                                        }
                                      });
}

namespace {

// The walk that References and ReferenceNames share: both resolve with the unit's own association class.
template <typename Visit>
CMPIStatus forEachReferenced(const AssociationCall& call, const CMPIContext* ctx, const CMPIObjectPath* op,
                             const char* WordInSequence::*operation, Visit visit) {
  Navigation navigation(call, ctx, op);
  const bool resolved = navigation.resolve(call.unit.association.name, nullptr);
  navigation.makeAssociationPath();
  if (!resolved) {
    return navigation.fail("Object Path is NULL in References.");  // compatibility 8: for the names too
  }
  return navigation.forEachAssociated(wordOf(call.unit, operation),
                                      [&](const CMPIInstance* instance) { visit(navigation, instance); });
}

}  // namespace

CMPIStatus references(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                      const CMPIObjectPath* op) {
  return forEachReferenced(call, ctx, op, &WordInSequence::references,
                           [&](Navigation& navigation, const CMPIInstance* instance) {
                             CMReturnInstance(rslt, navigation.makeReference(instance).instance);
                           });
}

CMPIStatus referenceNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* op) {
  return forEachReferenced(call, ctx, op, &WordInSequence::referenceNames,
                           [&](Navigation& navigation, const CMPIInstance* instance) {
                             const auto reference = navigation.makeReference(instance);
                             // A name that lacked the key of one end would name nothing.
                             if (!reference.hasFarEnd) {
                               return;
                             }
                             if (const CMPIObjectPath* path = navigation.rehomedPathOf(reference.instance)) {
                               CMReturnObjectPath(rslt, path);
                             }
                           });
}

}  // namespace QV::IPConfigComposite
