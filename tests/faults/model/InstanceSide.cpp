// SPDX-License-Identifier: Apache-2.0
// What the providers of the six composite classes answer to the three reading operations.
#include <cmpimacs.h>

#include "tests/faults/model/Access.h"
#include "tests/faults/model/Operations.h"
#include "tests/faults/model/Steps.h"

namespace Testing::Model {

namespace {

class InstanceSide : Steps {
 public:
  explicit InstanceSide(const Request& request) : Steps(request) {}

  CMPIStatus answer() {
    switch (request_.operation) {
      case Operation::GetInstance:
        return getInstance();
      case Operation::EnumInstances:
        return enumInstances();
      default:
        return enumInstanceNames();
    }
  }

 private:
  bool readOwnClass(const char** properties, Instances& out) {
    const std::string className = classNameOf(request_.path, &status_);
    return getAll(className, compositeOf(request_.className), properties, out, &status_);
  }

  CMPIStatus getInstance() {
    operation_.operationEntry(207);
    if (CMGetKeyCount(request_.path, &status_) == 0) {
      const char* text = "At least one key should be passed";
      status_.rc = CMPI_RC_ERR_FAILED;
      status_.msg = CMNewString(request_.broker, text, nullptr);
      traceToBroker(1, text);
      CMReturnDone(request_.result);
      operation_.operationExit(265);
      return status_;
    }
    Instances instances;
    if (!readOwnClass(request_.properties, instances)) {
      return status_;
    }
    returnMatching(instances, false);
    CMReturnDone(request_.result);
    operation_.operationExit(265);
    return status_;
  }

  CMPIStatus enumInstances() {
    operation_.operationEntry(75);
    Instances instances;
    if (!readOwnClass(request_.properties, instances)) {
      operation_.operationExit(98);
      return status_;
    }
    for (const CMPIInstance* instance : instances) {
      CMReturnInstance(request_.result, instance);
    }
    CMReturnDone(request_.result);
    operation_.operationExit(114);
    return status_;
  }

  CMPIStatus enumInstanceNames() {
    operation_.operationEntry(137);
    Instances instances;
    if (!readOwnClass(nullptr, instances)) {
      return status_;
    }
    for (const CMPIInstance* instance : instances) {
      returnRehomedPath(pathOf(instance, &status_));
    }
    CMReturnDone(request_.result);
    operation_.operationExit(184);
    return status_;
  }
};

}  // namespace

CMPIStatus readInstances(const Request& request) { return InstanceSide(request).answer(); }

}  // namespace Testing::Model
