// SPDX-License-Identifier: Apache-2.0
// The object manager that all runs stand in front of, and the underlying instances that it answers with.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "cimom/ObjectManager.h"
#include "cimom/model/Instance.h"
#include "tests/faults/Requests.h"

namespace Testing {

class World {
 public:
  World();
  World(const World&) = delete;
  World& operator=(const World&) = delete;

  const CMPIBroker* broker() const { return broker_; }
  const CMPIResult* result() const { return result_; }

  // The interfaces of a provider; the second is null where it has none.
  CMPIInstanceMI* instanceMi(const Unit& unit) const { return instanceMis_.at(unit.file); }
  CMPIAssociationMI* associationMi(const Unit& unit) const { return associationMis_.at(unit.file); }

  // The instance that the client sends with a change.
  CMPIInstance* change(const Request& request) const;

 private:
  using Texts = std::vector<std::pair<const char*, const char*>>;

  static CMPIEnumeration* enumerateInstances(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**,
                                             CMPIStatus*);

  Cimom::Instance instanceOf(const char* className, const Texts& properties) const;
  void add(Cimom::Instance instance);
  void addSystems();
  void addEndpoints();
  void addSettings(const char* className, const std::vector<const char*>& identifiers);
  void addAccessPoints();

  Cimom::ObjectManager manager_;
  const CMPIBroker* broker_;
  CMPIResult* result_;
  std::map<std::string, CMPIInstanceMI*> instanceMis_;
  std::map<std::string, CMPIAssociationMI*> associationMis_;
  std::map<std::string, std::vector<Cimom::Value>> underlying_;  // by class
};

World& world();

}  // namespace Testing
