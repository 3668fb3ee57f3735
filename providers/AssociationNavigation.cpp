// The association side: from a source object to what lies at the far end.
#include <QV/ProviderHelper.h>
#include <Trace.h>

#include <cstring>

#include "AssociationOperations.h"
#include "CmpiAccess.h"

namespace QV::IPConfigComposite {

namespace {

// Everything that the four operations do alike; each brings what it does with one far-end instance.
class Navigation {
 public:
  Navigation(const AssociationCall& call, const CMPIContext* ctx, const CMPIObjectPath* op)
      : unit_(call.unit),
        frame_(call.unit.component, call.unit.file, call.function),
        broker_(call.broker),
        ctx_(ctx),
        op_(op) {
    frame_.markEntry();
    if (unit_.kindWords != nullptr) {
      sourceIdentifier_ = textOf(keyOf(op_, "InstanceID", &status_), &status_);
    }
  }

  // Finds the class at the far end; false where the model has none.
  bool resolve(const char* assocClass, const char* resultClass) {
    target_ = IPConfigObjectFactory().get_assoc_targetClass_ObjectPath(broker_, op_, assocClass, resultClass, &status_);
    return !CMIsNullObject(target_);
  }

  CMPIStatus fail(const char* message) {
    frame_.failure(message);
    return status_;
  }

  // Hands every associated far-end instance to `visit`. A far end that cannot be read ends the operation without the
  // exit marker.
  template <typename Visit>
  CMPIStatus forEachAssociated(const char* kindWord, Visit visit) {
    const std::string targetClass = classNameOf(target_, &status_);
    farEnd_ = targetClass == unit_.endA.className   ? &unit_.endA
              : targetClass == unit_.endB.className ? &unit_.endB
                                                    : nullptr;
    if (farEnd_ != nullptr) {
      std::vector<CMPIInstance*> instances;
      IPConfigObjectFactory factory;
      if ((factory.*farEnd_->getAll)(broker_, ctx_, op_, farEnd_->className, nullptr, false, instances, &status_) !=
          0) {
        return status_;
      }
      for (std::uint16_t i = 0; i < countOf(instances); ++i) {
        if (isAssociated(instances.at(i), kindWord)) {
          visit(instances.at(i));
        }
      }
    }
    frame_.markExit();
    return status_;
  }

  // The keyless path that all association instances of one call are made on.
  void makeAssociationPath() {
    associationPath_ = CMNewObjectPath(broker_, nameSpaceOf(op_, &status_), unit_.associationClass, &status_);
  }

  // What ties the source to one far-end instance.
  struct Reference {
    CMPIInstance* instance;  // null where it could not be made
    bool hasFarEnd;          // whether the far-end instance has a path to refer to
  };

  // A new association instance between the source, its path as received, and a far-end instance.
  Reference makeReference(const CMPIInstance* farInstance) {
    CMPIInstance* const instance =
        associationPath_ == nullptr ? nullptr : CMNewInstance(broker_, associationPath_, &status_);
    const CMPIObjectPath* const farPath = rehomedPathOf(farInstance);
    const bool farIsA = farEnd_ == &unit_.endA;
    setReference(instance, unit_.referenceToA, farIsA ? farPath : op_);
    setReference(instance, unit_.referenceToB, farIsA ? op_ : farPath);
    return {instance, farPath != nullptr};
  }

  CMPIObjectPath* rehomedPathOf(const CMPIInstance* instance) {
    CMPIObjectPath* const path = pathOf(instance, &status_);
    rehome(path, op_, &status_);
    return path;
  }

 private:
  bool isAssociated(const CMPIInstance* farInstance, const char* kindWord) {
    if (unit_.kindWords == nullptr) {
      return true;
    }
    const std::string identifier = textOf(propertyOf(farInstance, "InstanceID", &status_), &status_);
    if (identifier.empty()) {
      return false;
    }
    if (farEnd_ == &unit_.endA) {
      return identifier.find(sourceIdentifier_) != std::string::npos && identifier.find(kindWord) != std::string::npos;
    }
    return sourceIdentifier_.find(identifier) != std::string::npos;
  }

  const AssociationUnit& unit_;
  const Frame frame_;
  const CMPIBroker* broker_;
  const CMPIContext* ctx_;
  const CMPIObjectPath* op_;
  CMPIStatus status_ = {CMPI_RC_OK, nullptr};
  std::string sourceIdentifier_;
  const CMPIObjectPath* target_ = nullptr;
  const CMPIObjectPath* associationPath_ = nullptr;
  const End* farEnd_ = nullptr;
};

const char* kindWordOf(const AssociationUnit& unit, const char* KindWords::*operation) {
  return unit.kindWords == nullptr ? nullptr : unit.kindWords->*operation;
}

}  // namespace

CMPIStatus associators(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char* assocClass, const char* resultClass) {
  Navigation navigation(call, ctx, op);
  if (!navigation.resolve(assocClass, resultClass)) {
    return navigation.fail("Object Path is NULL in Associators.");
  }
  return navigation.forEachAssociated(kindWordOf(call.unit, &KindWords::associators),
                                      [&](const CMPIInstance* instance) { CMReturnInstance(rslt, instance); });
}

CMPIStatus associatorNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                           const CMPIObjectPath* op, const char* assocClass, const char* resultClass) {
  Navigation navigation(call, ctx, op);
  if (!navigation.resolve(assocClass, resultClass)) {
    return navigation.fail("Object Path is NULL in AssociatorNames.");
  }
  return navigation.forEachAssociated(kindWordOf(call.unit, &KindWords::associatorNames),
                                      [&](const CMPIInstance* instance) {
                                        if (const CMPIObjectPath* const path = navigation.rehomedPathOf(instance)) {
                                          CMReturnObjectPath(rslt, path);
                                        }
                                      });
}

namespace {

// The walk that References and ReferenceNames share: both resolve with the unit's own association class.
template <typename Visit>
CMPIStatus forEachReferenced(const AssociationCall& call, const CMPIContext* ctx, const CMPIObjectPath* op,
                             const char* KindWords::*operation, Visit visit) {
  Navigation navigation(call, ctx, op);
  const bool resolved = navigation.resolve(call.unit.associationClass, nullptr);
  navigation.makeAssociationPath();
  if (!resolved) {
    return navigation.fail("Object Path is NULL in References.");
  }
  return navigation.forEachAssociated(kindWordOf(call.unit, operation),
                                      [&](const CMPIInstance* instance) { visit(navigation, instance); });
}

}  // namespace

CMPIStatus references(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                      const CMPIObjectPath* op) {
  return forEachReferenced(call, ctx, op, &KindWords::references,
                           [&](Navigation& navigation, const CMPIInstance* instance) {
                             CMReturnInstance(rslt, navigation.makeReference(instance).instance);
                           });
}

CMPIStatus referenceNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* op) {
  return forEachReferenced(call, ctx, op, &KindWords::referenceNames,
                           [&](Navigation& navigation, const CMPIInstance* instance) {
                             const auto reference = navigation.makeReference(instance);
                             // A name that lacked the key of one end would name nothing.
                             if (!reference.hasFarEnd) {
                               return;
                             }
                             if (const CMPIObjectPath* const path = navigation.rehomedPathOf(reference.instance)) {
                               CMReturnObjectPath(rslt, path);
                             }
                           });
}

}  // namespace QV::IPConfigComposite
