// SPDX-License-Identifier: Apache-2.0
// What the providers of the six associations answer to the three reading operations, and their builders.
#include <cmpimacs.h>

#include <optional>

#include "tests/faults/model/Access.h"
#include "tests/faults/model/Operations.h"
#include "tests/faults/model/Steps.h"

namespace Testing::Model {

namespace {

class AssociationInstances : Steps {
 public:
  explicit AssociationInstances(const Request& request)
      : Steps(request), association_(associationOf(request.className)) {}

  CMPIStatus answer() {
    switch (request_.operation) {
      case Operation::GetInstance:
        return getAssociation();
      case Operation::EnumInstances:
        return enumAssociations();
      default:
        return enumAssociationNames();
    }
  }

 private:
  CMPIStatus getAssociation() {
    operation_.operationEntry();
    if (CMGetKeyCount(request_.path, &status_) == 0) {
      operation_.message("At least one key should be passed", failure);
    } else {
      Instances instances;
      if (build(request_.properties, instances) == 0) {
        returnMatching(instances, true);
      }
    }
    CMReturnDone(request_.result);
    operation_.operationExit();
    return status_;
  }

  CMPIStatus enumAssociations() {
    operation_.operationEntry();
    Instances instances;
    if (build(request_.properties, instances) == 0) {
      for (const CMPIInstance* instance : instances) {
        CMReturnInstance(request_.result, instance);
      }
    }
    CMReturnDone(request_.result);
    operation_.operationExit();
    return status_;
  }

  CMPIStatus enumAssociationNames() {
    operation_.operationEntry();
    Instances instances;
    if (build(nullptr, instances) == 0) {
      for (const CMPIInstance* instance : instances) {
        const CMPIObjectPath* path = pathOf(instance, &status_);
        if (usable(path)) {
          CMReturnObjectPath(request_.result, path);
        }
      }
    }
    CMReturnDone(request_.result);
    operation_.operationExit();
    return status_;
  }

  // The builders. A reaction that ends answers its result.

  std::optional<int> react(const Report& report, const Reaction& reaction) {
    if (!reaction.message.empty()) {
      report.message(reaction.message, failure, reaction.line);
    }
    return reaction.result;
  }

  bool readEnd(const char* className, Instances& out, CMPIStatus* status) {
    return getAll(className, compositeOf(className), nullptr, out, status);
  }

  int build(const char** properties, Instances& out) {
    const Report report = {operation_.component, operation_.file, association_.builder};
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    report.operationEntry(association_.entryLine);
    Instances outers;
    if (!readEnd(association_.outer, outers, &status)) {
      return *react(report, association_.outerFails);
    }
    for (const CMPIInstance* outer : outers) {
      if (!usable(outer)) {
        if (const auto result = react(report, association_.outerUnusable)) {
          return *result;
        }
        continue;
      }
      // An end without a path pairs with nothing.
      CMPIObjectPath* outerPath = CMGetObjectPath(outer, &status);
      if (!usable(outerPath)) {
        continue;
      }
      rehome(outerPath, &status);
      if (association_.ordered) {
        CMGetKey(outerPath, "InstanceID", &status);
      }
      Instances inners;
      if (!readEnd(association_.inner, inners, &status)) {
        if (const auto result = react(report, association_.innerFails)) {
          return *result;
        }
        continue;
      }
      for (const CMPIInstance* inner : inners) {
        if (const auto result = pair(report, outerPath, inner, properties, out, &status)) {
          return *result;
        }
      }
    }
    report.operationExit(association_.exitLine);
    return 0;
  }

  std::optional<int> pair(const Report& report, const CMPIObjectPath* outerPath, const CMPIInstance* inner,
                          const char** properties, Instances& out, CMPIStatus* status) {
    if (!usable(inner)) {
      return react(report, association_.innerUnusable);
    }
    CMPIObjectPath* innerPath = CMGetObjectPath(inner, status);
    if (!usable(innerPath)) {
      return std::nullopt;
    }
    rehome(innerPath, status);
    if (association_.ordered && !holds(textIn(CMGetKey(innerPath, "InstanceID", status), status), association_.word)) {
      return std::nullopt;
    }
    const std::string nameSpace = nameSpaceOf(request_.path, status);
    CMPIObjectPath* path = CMNewObjectPath(request_.broker, nameSpace.c_str(), association_.name, status);
    if (!usable(path)) {
      return react(report, association_.pathUnmade);
    }
    rehome(path, status);
    const CMPIObjectPath* first = association_.firstHoldsOuter ? outerPath : innerPath;
    const CMPIObjectPath* second = association_.firstHoldsOuter ? innerPath : outerPath;
    if (association_.keysOnPath) {
      CMAddKey(path, association_.first, &first, CMPI_ref);
      CMAddKey(path, association_.second, &second, CMPI_ref);
    }
    CMPIInstance* instance = CMNewInstance(request_.broker, path, nullptr);
    if (!usable(instance)) {
      if (association_.appendsUnmade) {
        out.push_back(instance);
      }
      return std::nullopt;
    }
    const char* keys[] = {association_.first, association_.second, nullptr};
    CMSetPropertyFilter(instance, properties, keys);
    setReference(instance, association_.first, first);
    setReference(instance, association_.second, second);
    if (association_.flags) {
      setFlags(instance, innerPath);
    }
    out.push_back(instance);
    return std::nullopt;
  }

  static void setFlags(CMPIInstance* instance, const CMPIObjectPath* sequencePath) {
    CMPIStatus read = {CMPI_RC_OK, nullptr};
    CMPIStatus conversion = {CMPI_RC_OK, nullptr};
    const std::string identifier = textIn(CMGetKey(sequencePath, "InstanceID", &read), &conversion);
    const bool known = read.rc == CMPI_RC_OK && conversion.rc == CMPI_RC_OK;
    const CMPIUint16 inForce = known && fieldsOf(identifier).size() > 2 ? 2 : 1;
    const CMPIUint16 next = 3;
    CMSetProperty(instance, "IsDefault", &inForce, CMPI_uint16);
    CMSetProperty(instance, "IsCurrent", &inForce, CMPI_uint16);
    CMSetProperty(instance, "IsNext", &next, CMPI_uint16);
  }

  const Association& association_;
};

}  // namespace

CMPIStatus readAssociations(const Request& request) { return AssociationInstances(request).answer(); }

}  // namespace Testing::Model
