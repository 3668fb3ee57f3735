// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "cimom/routing/SameObject.h"

namespace {

using namespace Cimom;

ObjectPath keyed(const std::string& nameSpace, const std::string& className, const Value& key,
                 const std::string& keyName = "K") {
  ObjectPath made{"", nameSpace, className, {}};
  made.keys.set(keyName, key);
  return made;
}

Value moment(const char* text) { return Value::dateTime(DateTime::parse(text)); }

TEST(SameObjectTest, KeysAreTheSameWhereTheySayTheSame) {
  const struct {
    Value one;
    Value other;
    bool same;
  } rows[] = {
      {Value::uint32(7), Value::sint64(7), true},
      {Value::uint32(7), Value::string("7"), true},
      {Value::uint32(7), Value::uint32(8), false},
      {Value::boolean(true), Value::string("TRUE"), true},
      {Value::string("a"), Value::string("A"), false},
      {Value::null(CMPI_string), Value::null(CMPI_uint32), true},
      {Value::null(CMPI_string), Value::string("NULL"), false},
      {Value::string("NULL"), Value::null(CMPI_string), false},
      {moment("00000001000000.000000:000"), moment("00000001000000.000000:000"), true},
      {moment("00000001000000.000000:000"), moment("00000002000000.000000:000"), false},
      // The same moment, written in two time zones.
      {moment("20260101120000.000000+060"), moment("20260101110000.000000+000"), true},
      {moment("00000001000000.000000:000"), moment("20260101110000.000000+000"), false},
      {moment("00000001000000.000000:000"), Value::string("1"), false},
      {Value::reference(keyed("", "C", Value::uint32(1))), Value::reference(keyed("root/test", "c", Value::uint64(1))),
       true},
      {Value::reference(keyed("", "C", Value::uint32(1))), Value::reference(keyed("root/other", "C", Value::uint32(1))),
       false},
      {Value::reference(keyed("", "C", Value::uint32(1))), Value::string("C.K=1"), false},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(sameKey(row.one, row.other, "root/test"), row.same) << row.one.toString() << " " << row.other.toString();
  }
}

TEST(SameObjectTest, ObjectsAreTheSameByNamespaceClassAndKeys) {
  const ObjectPath one = keyed("", "C", Value::uint32(1));
  ObjectPath hosted = keyed("ROOT/test", "c", Value::uint32(1), "k");
  hosted.host = "elsewhere";
  EXPECT_TRUE(sameObject(one, hosted, "root/test")) << "hosts and cases do not count";
  ObjectPath more = one;
  more.keys.set("Other", Value::uint32(2));
  for (const ObjectPath& other : {keyed("root/other", "C", Value::uint32(1)), keyed("", "D", Value::uint32(1)),
                                  keyed("", "C", Value::uint32(2)), keyed("", "C", Value::uint32(1), "L"), more}) {
    EXPECT_FALSE(sameObject(one, other, "root/test")) << other.toString();
    EXPECT_FALSE(sameObject(other, one, "root/test")) << other.toString();
  }
}

}  // namespace
