// A real broker with a request under way, and a class of every type to try the helpers on.
#pragma once

#include <cmpimacs.h>
#include <gtest/gtest.h>

#include <string>

#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"

namespace QV {

class WithBroker : public testing::Test {
 protected:
  WithBroker() {
    manager_.loadSchemaText(R"(
      class Sample {
        [key] string Id;
        string Text; boolean Truth; char16 Letter; datetime Moment; real32 Single; real64 Double;
        uint8 U8; uint16 U16; uint32 U32; uint64 U64; sint8 S8; sint16 S16; sint32 S32; sint64 S64;
        uint16 Numbers[];
      };
      class Keyed { [key] string A; [key] string B; };
    )",
                            "root/test");
  }

  const CMPIBroker* broker() const { return manager_.broker(); }

  CMPIObjectPath* path(const char* className, const char* nameSpace = "root/test") const {
    CMPIObjectPath* made = CMNewObjectPath(broker(), nameSpace, className, nullptr);
    EXPECT_NE(made, nullptr);
    return made;
  }

  CMPIInstance* sample() const {
    CMPIInstance* made = CMNewInstance(broker(), path("Sample"), nullptr);
    EXPECT_NE(made, nullptr);
    return made;
  }

  static CMPIData instanceData(CMPIInstance* instance) {
    CMPIData data{};
    data.type = CMPI_instance;
    data.value.inst = instance;
    return data;
  }

  static std::string characters(const CMPIString* string) { return CMGetCharsPtr(string, nullptr); }

  Cimom::ObjectManager manager_;

 private:
  Cimom::RequestScope scope_{manager_.broker()};
};

}  // namespace QV
