// SPDX-License-Identifier: Apache-2.0
// The steps that the operations share, over one request and the status that it threads through its calls.
#pragma once

#include <vector>

#include "tests/faults/model/Data.h"
#include "tests/faults/model/Model.h"
#include "tests/faults/model/Report.h"

namespace Testing::Model {

using Instances = std::vector<CMPIInstance*>;

class Steps {
 protected:
  explicit Steps(const Request& request);

  void traceToBroker(int level, const char* text) const;

  // Gives the path the namespace of the request and the system's name as host.
  void rehome(CMPIObjectPath* path, CMPIStatus* status) const;
  static void setReference(CMPIInstance* instance, const char* name, const CMPIObjectPath* path);

  // All composite instances of the class; false where the class is not the one that was asked for, or where memory is
  // short.
  bool getAll(const std::string& className, const Composite& composite, const char** properties, Instances& out,
              CMPIStatus* status) const;

  // The first whose path is the request's.
  void returnMatching(const Instances& instances, bool flag);
  // A path that cannot be followed is no answer.
  void returnRehomedPath(CMPIObjectPath* path);

  const Request& request_;
  const Report operation_;
  CMPIStatus status_ = {CMPI_RC_OK, nullptr};

 private:
  CMPIInstance* make(const Composite& composite, const char** properties, CMPIStatus* status) const;
  bool addSystemProperties(const Report& report, const CMPIInstance* underlying, CMPIInstance* composite,
                           CMPIUint16 index, CMPIStatus* status) const;
};

}  // namespace Testing::Model
