// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "tests/support/broker/BrokerFixture.h"

namespace Testing {

// A small schema with what a real one has: an inheritance of three levels, keys, defaults, every kind of property, and
// associations.
inline constexpr const char* testSchema = R"MOF(
Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);
Qualifier Association : boolean = false, Scope(association), Flavor(DisableOverride, ToSubclass);
Qualifier Description : string = null, Scope(any), Flavor(EnableOverride, ToSubclass, Translatable);

[Abstract, Version("2.1"), Description("The root")]
class CIM_Element {
  [Description("What people call it")] string Caption = "none";
  [Description("Returns 0")] uint32 Reset([IN, Description("How")] boolean Force);
};

[Description("A system")]
class CIM_System : CIM_Element {
  [Key] string CreationClassName;
  [Key] string Name;
  uint16 EnabledState = 5;
  uint8 Small;
  uint64 Large;
  sint32 Offset;
  boolean Ready;
  real64 Load;
  datetime Installed;
  uint16 Dedicated[];
  string Notes[];
};

class TST_Processor : CIM_System {
  string Vendor = "nobody";
};

class TST_Other : CIM_System {
};

class CIM_Point : CIM_Element {
  [Key] uint16 Number;
};

class TST_Point : CIM_Point {
};

[Association]
class CIM_Hosted {
  [Key] CIM_System REF Antecedent;
  [Key] CIM_Point REF Dependent;
};

[Association]
class TST_Hosted : CIM_Hosted {
};

[Association]
class TST_Peers {
  [Key] CIM_Point REF Left;
  [Key] CIM_Point REF Right;
};
)MOF";

class ManagedElementsFixture : public BrokerFixture {
 protected:
  ManagedElementsFixture() { manager.loadSchemaText(testSchema, testNamespace); }

  // A path of TST_Processor or another CIM_System class with both keys.
  CMPIObjectPath* systemPath(const char* name, const char* className = "TST_Processor") const {
    CMPIObjectPath* made = path(className);
    CMAddKey(made, "CreationClassName", className, CMPI_chars);
    CMAddKey(made, "Name", name, CMPI_chars);
    return made;
  }

  CMPIInstance* system(const char* name, const char* className = "TST_Processor") const {
    return CMNewInstance(broker, systemPath(name, className), nullptr);
  }

  CMPIStatus status = {CMPI_RC_ERROR, nullptr};
};

}  // namespace Testing
