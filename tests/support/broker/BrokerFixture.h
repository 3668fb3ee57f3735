// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpimacs.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <type_traits>

#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"

namespace Testing {

inline constexpr const char* testNamespace = "root/test";

// An object manager without a class, and a request on the test's thread.
class BrokerFixture : public testing::Test {
 protected:
  CMPIObjectPath* path(const char* className, const char* nameSpace = testNamespace) const {
    return CMNewObjectPath(broker, nameSpace, className, nullptr);
  }

  static std::string characters(const CMPIString* string) { return CMGetCharsPtr(string, nullptr); }

  Cimom::ObjectManager manager;
  const CMPIBroker* broker = manager.broker();
  Cimom::RequestScope request{broker};
};

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

}  // namespace Testing
