// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "tests/support/broker/BrokerFixture.h"

namespace Testing {

// A broker with a class of every type, to try the helpers on.
class SampleFixture : public BrokerFixture {
 protected:
  SampleFixture() {
    manager.loadSchemaText(R"(
      class Sample {
        [key] string Id;
        string Text; boolean Truth; char16 Letter; datetime Moment; real32 Single; real64 Double;
        uint8 U8; uint16 U16; uint32 U32; uint64 U64; sint8 S8; sint16 S16; sint32 S32; sint64 S64;
        uint16 Numbers[];
      };
      class Keyed { [key] string A; [key] string B; };
    )",
                           testNamespace);
  }

  CMPIInstance* sample() const {
    CMPIInstance* made = CMNewInstance(broker, path("Sample"), nullptr);
    EXPECT_TRUE(made);
    return made;
  }

  static CMPIData instanceData(CMPIInstance* instance) {
    CMPIData data{};
    data.type = CMPI_instance;
    data.value.inst = instance;
    return data;
  }
};

}  // namespace Testing
