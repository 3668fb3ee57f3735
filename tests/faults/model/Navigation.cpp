// SPDX-License-Identifier: Apache-2.0
// What the four association operations answer.
#include <QV/ProviderHelper.h>
#include <cmpimacs.h>

#include <functional>

#include "tests/faults/model/Access.h"
#include "tests/faults/model/Operations.h"
#include "tests/faults/model/Steps.h"

namespace Testing::Model {

namespace {

class Navigation : Steps {
 public:
  explicit Navigation(const Request& request) : Steps(request), association_(associationOf(request.className)) {}

  CMPIStatus answer() {
    switch (request_.operation) {
      case Operation::Associators:
        return associators();
      case Operation::AssociatorNames:
        return associatorNames();
      case Operation::References:
        return references();
      default:
        return referenceNames();
    }
  }

 private:
  std::string farEndOf(const char* associationClass) {
    const Report report = memberReport("get_assoc_targetClass_Name");
    report.entering();
    const std::string source = classNameOf(request_.path, &status_);
    for (const FarEnd& row : farEnds) {
      if (QV::textEqual(source.c_str(), row.source) && QV::textEqual(associationClass, row.association)) {
        report.message(row.target);
        return row.target;
      }
    }
    report.message("Target Assoc Class Not Found");
    report.variable("sourceclass", source);
    return "";
  }

  CMPIObjectPath* resolve(const char* associationClass) {
    const Report report = memberReport("get_assoc_targetClass_ObjectPath");
    report.entering();
    const std::string target = farEndOf(associationClass);
    report.variable("targetName", target);
    if (QV::textEqual(target.c_str(), "")) {
      return nullptr;
    }
    report.message(" Creating CMNewObjectPath");
    const std::string nameSpace = nameSpaceOf(request_.path, &status_);
    CMPIObjectPath* path = CMNewObjectPath(request_.broker, nameSpace.c_str(), target.c_str(), &status_);
    rehome(path, &status_);
    return path;
  }

  CMPIStatus breakOff(const char* message) {
    operation_.message(message, failure);
    return status_;
  }

  void open() {
    operation_.operationEntry();
    if (association_.ordered) {
      sourceIdentifier_ = textIn(CMGetKey(request_.path, "InstanceID", &status_), &status_);
    }
  }

  bool isAssociated(const CMPIInstance* farInstance, bool farIsSequence, const char* word) {
    if (!association_.ordered) {
      return true;
    }
    const std::string identifier = textProperty(farInstance, "InstanceID", &status_, &status_);
    if (identifier.empty()) {
      return false;  // what bears no identifier belongs to nothing
    }
    return farIsSequence ? holds(identifier, sourceIdentifier_) && holds(identifier, word)
                         : holds(sourceIdentifier_, identifier);
  }

  bool readEnd(const char* className, Instances& out) {
    return getAll(className, compositeOf(className), nullptr, out, &status_);
  }

  CMPIStatus walk(const CMPIObjectPath* target, const char* word,
                  const std::function<void(CMPIInstance*, bool farIsEndA)>& visit) {
    const std::string className = classNameOf(target, &status_);
    const bool isEndA = className == association_.endA;
    if (isEndA || className == association_.endB) {
      Instances instances;
      if (!readEnd(isEndA ? association_.endA : association_.endB, instances)) {
        return status_;
      }
      for (CMPIInstance* instance : instances) {
        if (isAssociated(instance, isEndA, word)) {
          visit(instance, isEndA);
        }
      }
    }
    operation_.operationExit();
    return status_;
  }

  CMPIStatus associators() {
    open();
    const CMPIObjectPath* target = resolve(request_.associationClass);
    if (!usable(target)) {
      return breakOff("Object Path is NULL in Associators.");
    }
    return walk(target, association_.word,
                [&](const CMPIInstance* instance, bool) { CMReturnInstance(request_.result, instance); });
  }

  CMPIStatus associatorNames() {
    open();
    const CMPIObjectPath* target = resolve(request_.associationClass);
    if (!usable(target)) {
      return breakOff("Object Path is NULL in AssociatorNames.");
    }
    return walk(target, association_.word,
                [&](const CMPIInstance* instance, bool) { returnRehomedPath(pathOf(instance, &status_)); });
  }

  struct Reference {
    CMPIInstance* instance;
    bool hasBothEnds;
  };

  // Without a path to make it on there is no instance.
  Reference makeReference(const CMPIObjectPath* associationPath, const CMPIInstance* farInstance, bool farIsEndA) {
    CMPIInstance* instance =
        usable(associationPath) ? CMNewInstance(request_.broker, associationPath, &status_) : nullptr;
    CMPIObjectPath* farPath = pathOf(farInstance, &status_);
    rehome(farPath, &status_);
    setReference(instance, association_.propertyA, farIsEndA ? farPath : request_.path);
    setReference(instance, association_.propertyB, farIsEndA ? request_.path : farPath);
    return {instance, usable(farPath)};
  }

  CMPIStatus referTo(const char* word, const std::function<void(const Reference&)>& answer) {
    open();
    const CMPIObjectPath* target = resolve(association_.name);
    const std::string nameSpace = nameSpaceOf(request_.path, &status_);
    const CMPIObjectPath* associationPath =
        CMNewObjectPath(request_.broker, nameSpace.c_str(), association_.name, &status_);
    if (!usable(target)) {
      return breakOff("Object Path is NULL in References.");
    }
    return walk(target, word, [&](const CMPIInstance* farInstance, bool farIsEndA) {
      answer(makeReference(associationPath, farInstance, farIsEndA));
    });
  }

  CMPIStatus references() {
    return referTo(association_.word,
                   [&](const Reference& reference) { CMReturnInstance(request_.result, reference.instance); });
  }

  CMPIStatus referenceNames() {
    return referTo(association_.wordOfReferenceNames, [&](const Reference& reference) {
      // The name of a reference that lacks an end would name nothing.
      if (reference.hasBothEnds) {
        returnRehomedPath(pathOf(reference.instance, &status_));
      }
    });
  }

  const Association& association_;
  std::string sourceIdentifier_;
};

}  // namespace

CMPIStatus navigate(const Request& request) { return Navigation(request).answer(); }

}  // namespace Testing::Model
