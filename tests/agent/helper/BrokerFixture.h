// A real broker with a request under way, and a class of every type to try the helpers on.
#pragma once

#include <cmpimacs.h>
#include <gtest/gtest.h>

#include <string>
#include <type_traits>

#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"

namespace QV {

// An object of the broker with a table of its own, whose slots a test replaces: what an object manager may hand out.
template <typename Object>
class Altered {
 public:
  using Table = std::remove_pointer_t<decltype(Object::ft)>;

  explicit Altered(Object* object) : table(*object->ft), object_(object), original_(object->ft) { object->ft = &table; }
  ~Altered() { object_->ft = original_; }
  Altered(const Altered&) = delete;
  Altered& operator=(const Altered&) = delete;

  operator Object*() const { return object_; }

  Table table;

 private:
  Object* const object_;
  Table* const original_;
};

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
