// SPDX-License-Identifier: Apache-2.0
// The twelve provider units as the tests drive them: their factories, names and classes.
#pragma once

#include <cmpift.h>
#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <vector>

#include "tests/support/Classes.h"

namespace Testing {

using CreateInstanceMI = CMPIInstanceMI*(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
using CreateAssociationMI = CMPIAssociationMI*(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

struct Unit {
  std::string prefix;     // of the operations, as the trace lines show them
  std::string file;       // the unit's name in the trace lines
  std::string component;  // the unit's logger
  std::string provider;   // the name that registrations refer to
  std::string className;
  CreateInstanceMI* createInstanceMI;
  CreateAssociationMI* createAssociationMI;  // null for the six that serve no association
  bool acceptsModify;
};

// The name of a test that is run for each of several units.
inline std::string nameOf(const ::testing::TestParamInfo<Unit>& info) { return info.param.file; }

inline void PrintTo(const Unit& unit, std::ostream* stream) { *stream << unit.file; }

const std::vector<Unit>& instanceUnits();     // the six of the composite classes
const std::vector<Unit>& associationUnits();  // the six of the associations
std::vector<Unit> allUnits();

const Unit& unitOf(const std::string& className);

}  // namespace Testing
