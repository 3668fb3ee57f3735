// SPDX-License-Identifier: Apache-2.0
#include "tests/support/probe/ProbeObjects.h"

#include <cmpimacs.h>
#include <strings.h>

#include <atomic>
#include <mutex>

namespace Probe {
namespace {

constexpr const char* originalText = "<plain> & \"quoted\" \xE2\x82\xAC";

std::mutex mutex;
std::string currentText = originalText;
std::atomic<CMPIUint16> things = 2;

std::string chars(const CMPIString* string) {
  const char* text = string ? CMGetCharsPtr(string, nullptr) : nullptr;
  return text ? text : "";
}

template <typename Number>
void setNumber(CMPIInstance* instance, const char* name, Number CMPIValue::*member, Number number, CMPIType type) {
  CMPIValue value{};
  value.*member = number;
  CMSetProperty(instance, name, &value, type);
}

// With a null element where `withNull` says so, which older clients cannot read.
void setTexts(const CMPIBroker* broker, CMPIInstance* instance, bool withNull) {
  CMPIValue texts{};
  texts.array = CMNewArray(broker, 3, CMPI_string, nullptr);
  CMSetArrayElementAt(texts.array, 0, "one", CMPI_chars);
  if (!withNull) {
    CMSetArrayElementAt(texts.array, 1, "two", CMPI_chars);
  }
  CMSetArrayElementAt(texts.array, 2, "", CMPI_chars);
  CMSetProperty(instance, "Texts", &texts, CMPI_stringA);
}

void setNumbers(const CMPIBroker* broker, CMPIInstance* instance) {
  CMPIValue numbers{};
  numbers.array = CMNewArray(broker, 2, CMPI_uint16, nullptr);
  for (CMPICount i = 0; i < 2; ++i) {
    CMPIValue number{};
    number.uint16 = static_cast<CMPIUint16>(i + 14);
    CMSetArrayElementAt(numbers.array, i, &number, CMPI_uint16);
  }
  CMSetProperty(instance, "Numbers", &numbers, CMPI_uint16A);
}

CMPIInstance* thing(const CMPIBroker* broker, const char* nameSpace, const char* className, CMPIUint16 number) {
  CMPIInstance* instance = CMNewInstance(broker, thingPath(broker, nameSpace, className, number), nullptr);
  CMSetProperty(instance, "Name", "thing", CMPI_chars);
  setNumber(instance, "Number", &CMPIValue::uint16, number, CMPI_uint16);
  setNumber(instance, "Flag", &CMPIValue::boolean, CMPIBoolean{1}, CMPI_boolean);
  setNumber(instance, "Letter", &CMPIValue::char16, CMPIChar16{0x20AC}, CMPI_char16);
  setNumber(instance, "U8", &CMPIValue::uint8, CMPIUint8{255}, CMPI_uint8);
  setNumber(instance, "U32", &CMPIValue::uint32, CMPIUint32{4294967295U}, CMPI_uint32);
  setNumber(instance, "U64", &CMPIValue::uint64, CMPIUint64{18446744073709551615ULL}, CMPI_uint64);
  setNumber(instance, "S8", &CMPIValue::sint8, CMPISint8{-128}, CMPI_sint8);
  setNumber(instance, "S16", &CMPIValue::sint16, CMPISint16{-32768}, CMPI_sint16);
  setNumber(instance, "S32", &CMPIValue::sint32, CMPISint32{-2147483647}, CMPI_sint32);
  setNumber(instance, "S64", &CMPIValue::sint64, CMPISint64{-9223372036854775807LL}, CMPI_sint64);
  setNumber(instance, "R32", &CMPIValue::real32, CMPIReal32{1.5F}, CMPI_real32);
  setNumber(instance, "R64", &CMPIValue::real64, CMPIReal64{-0.25}, CMPI_real64);
  CMPIDateTime* moment = CMNewDateTimeFromChars(broker, "20260102030405.000000+060", nullptr);
  CMSetProperty(instance, "Moment", &moment, CMPI_dateTime);
  CMSetProperty(instance, "Text", text().c_str(), CMPI_chars);
  setTexts(broker, instance, false);
  setNumbers(broker, instance);
  return instance;
}

CMPIInstance* link(const CMPIBroker* broker, const char* nameSpace) {
  CMPIInstance* instance = CMNewInstance(broker, CMNewObjectPath(broker, nameSpace, "TEST_Link", nullptr), nullptr);
  CMPIObjectPath* whole = thingPath(broker, nameSpace, "TEST_Thing", 1);
  CMPIObjectPath* part = thingPath(broker, nameSpace, "TEST_Part", 3);
  CMSetProperty(instance, "Whole", &whole, CMPI_ref);
  CMSetProperty(instance, "Part", &part, CMPI_ref);
  setNumber(instance, "Strength", &CMPIValue::uint16, CMPIUint16{9}, CMPI_uint16);
  return instance;
}

CMPIInstance* numbered(const CMPIBroker* broker, const char* nameSpace) {
  CMPIInstance* instance = CMNewInstance(broker, CMNewObjectPath(broker, nameSpace, "TEST_Numbered", nullptr), nullptr);
  setNumber(instance, "Id", &CMPIValue::sint32, CMPISint32{-7}, CMPI_sint32);
  setTexts(broker, instance, true);
  CMSetProperty(instance, "Text", "control \x01 and \xFF", CMPI_chars);
  return instance;
}

// With an instance in a property, and two in an array.
CMPIInstance* machine(const CMPIBroker* broker, const char* nameSpace) {
  CMPIInstance* instance = CMNewInstance(broker, CMNewObjectPath(broker, nameSpace, "TEST_Machine", nullptr), nullptr);
  CMPIInstance* inner = numbered(broker, nameSpace);
  CMPIArray* inners = CMNewArray(broker, 2, CMPI_instance, nullptr);
  CMSetArrayElementAt(inners, 0, &inner, CMPI_instance);
  CMSetProperty(instance, "Name", "machine", CMPI_chars);
  CMSetProperty(instance, "Inner", &inner, CMPI_instance);
  CMSetProperty(instance, "Inners", &inners, CMPI_instanceA);
  CMSetProperty(instance, "Anything", &inner, CMPI_instance);
  return instance;
}

bool sameValue(const CMPIData& one, const CMPIData& other) {
  if (one.type != other.type) {
    return false;
  }
  switch (one.type) {
    case CMPI_ref:
      return same(one.value.ref, other.value.ref);
    case CMPI_string:
      return chars(one.value.string) == chars(other.value.string);
    case CMPI_uint16:
      return one.value.uint16 == other.value.uint16;
    case CMPI_sint32:
      return one.value.sint32 == other.value.sint32;
    default:
      return false;
  }
}

}  // namespace

std::string text() {
  const std::lock_guard lock(mutex);
  return currentText;
}

void setText(const std::string& text) {
  const std::lock_guard lock(mutex);
  currentText = text;
}

void setThings(CMPIUint16 count) { things = count; }

CMPIObjectPath* thingPath(const CMPIBroker* broker, const char* nameSpace, const char* className, CMPIUint16 number) {
  CMPIObjectPath* path = CMNewObjectPath(broker, nameSpace, className, nullptr);
  CMPIValue value{};
  value.uint16 = number;
  CMAddKey(path, "Name", "thing", CMPI_chars);
  CMAddKey(path, "Number", &value, CMPI_uint16);
  return path;
}

std::vector<CMPIInstance*> instancesOf(const CMPIBroker* broker, const CMPIObjectPath* path) {
  const std::string nameSpace = chars(CMGetNameSpace(path, nullptr));
  const std::string className = chars(CMGetClassName(path, nullptr));
  const auto is = [&className](const char* name) { return strcasecmp(className.c_str(), name) == 0; };
  if (is("TEST_Thing")) {
    std::vector<CMPIInstance*> all;
    for (CMPIUint16 number = 1; number <= things; ++number) {
      all.push_back(thing(broker, nameSpace.c_str(), "TEST_Thing", number));
    }
    return all;
  }
  if (is("TEST_Part")) {
    return {thing(broker, nameSpace.c_str(), "TEST_Part", 3)};
  }
  if (is("TEST_Link")) {
    return {link(broker, nameSpace.c_str())};
  }
  if (is("TEST_Numbered")) {
    return {numbered(broker, nameSpace.c_str())};
  }
  if (is("TEST_Machine")) {
    return {machine(broker, nameSpace.c_str())};
  }
  return {};
}

bool same(const CMPIObjectPath* one, const CMPIObjectPath* other) {
  const std::string className = chars(CMGetClassName(one, nullptr));
  const CMPICount count = CMGetKeyCount(one, nullptr);
  if (strcasecmp(className.c_str(), chars(CMGetClassName(other, nullptr)).c_str()) != 0) {
    return false;
  }
  for (CMPICount i = 0; i < count; ++i) {
    CMPIString* name = nullptr;
    const CMPIData key = CMGetKeyAt(one, i, &name, nullptr);
    if (!sameValue(key, CMGetKey(other, chars(name).c_str(), nullptr))) {
      return false;
    }
  }
  return count == CMGetKeyCount(other, nullptr);
}

}  // namespace Probe
