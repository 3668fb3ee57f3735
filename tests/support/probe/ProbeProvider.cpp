// SPDX-License-Identifier: Apache-2.0
// A CMPI provider for the tests of cimomd. Where the environment variable PROBE_DIRECTORY names a directory, the
// provider tells there by files what it does: "reached" once a request for TEST_Slow waits, which it does until there
// is a file "go", and "cleaned" once it has been cleaned up.
#include <cmpimacs.h>
#include <pthread.h>
#include <strings.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <thread>

#include "tests/support/probe/ProbeObjects.h"

namespace {

using namespace std::chrono_literals;

const CMPIBroker* broker = nullptr;

std::filesystem::path file(const char* name) {
  const char* directory = std::getenv("PROBE_DIRECTORY");
  return directory ? std::filesystem::path(directory) / name : std::filesystem::path();
}

void tell(const char* name) {
  if (const auto path = file(name); !path.empty()) {
    std::ofstream(path) << name;
  }
}

void waitForGo() {
  tell("reached");
  const auto deadline = std::chrono::steady_clock::now() + 60s;
  while (!std::filesystem::exists(file("go")) && std::chrono::steady_clock::now() < deadline) {
    std::this_thread::sleep_for(5ms);
  }
}

bool isClass(const CMPIObjectPath* path, const char* name) {
  return strcasecmp(CMGetCharsPtr(CMGetClassName(path, nullptr), nullptr), name) == 0;
}

// What the classes that behave badly do.
CMPIStatus behave(const CMPIObjectPath* path) {
  if (isClass(path, "TEST_Slow")) {
    waitForGo();
  }
  if (isClass(path, "TEST_Failing")) {
    CMReturnWithChars(broker, CMPI_RC_ERR_ACCESS_DENIED, "out of <order>");
  }
  CMReturn(CMPI_RC_OK);
}

CMPIStatus ProbeCleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
  tell("cleaned");
  CMReturn(CMPI_RC_OK);
}

CMPIStatus ProbeEnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                              const char**) {
  const CMPIStatus status = behave(path);
  if (status.rc != CMPI_RC_OK) {
    return status;
  }
  for (const CMPIInstance* instance : Probe::instancesOf(broker, path)) {
    CMReturnInstance(result, instance);
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeEnumInstanceNames(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                  const CMPIObjectPath* path) {
  const CMPIStatus status = behave(path);
  if (status.rc != CMPI_RC_OK) {
    return status;
  }
  for (const CMPIInstance* instance : Probe::instancesOf(broker, path)) {
    CMReturnObjectPath(result, CMGetObjectPath(instance, nullptr));
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeGetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                            const char**) {
  for (const CMPIInstance* instance : Probe::instancesOf(broker, path)) {
    if (Probe::same(path, CMGetObjectPath(instance, nullptr))) {
      CMReturnInstance(result, instance);
    }
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeCreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*,
                               const CMPIInstance* instance) {
  CMReturnObjectPath(result, CMGetObjectPath(instance, nullptr));
  return CMReturnDone(result);
}

CMPIStatus ProbeModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const CMPIInstance* instance, const char**) {
  const CMPIData text = CMGetProperty(instance, "Text", nullptr);
  Probe::setText(CMIsNullValue(text) ? "null" : CMGetCharsPtr(text.value.string, nullptr));
  CMReturn(CMPI_RC_OK);
}

CMPIStatus ProbeDeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*) {
  CMReturn(CMPI_RC_OK);
}

CMPIStatus ProbeExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*,
                          const char*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus ProbeAssociationCleanup(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) { CMReturn(CMPI_RC_OK); }

CMPIInstance* theLink(const CMPIObjectPath* source) {
  const char* nameSpace = CMGetCharsPtr(CMGetNameSpace(source, nullptr), nullptr);
  return Probe::instancesOf(broker, CMNewObjectPath(broker, nameSpace, "TEST_Link", nullptr)).front();
}

// The far end of the link as seen from the source; null if the source is no end of it.
CMPIObjectPath* farEnd(const CMPIObjectPath* source) {
  const CMPIInstance* link = theLink(source);
  CMPIObjectPath* whole = CMGetProperty(link, "Whole", nullptr).value.ref;
  CMPIObjectPath* part = CMGetProperty(link, "Part", nullptr).value.ref;
  if (Probe::same(source, whole)) {
    return part;
  }
  return Probe::same(source, part) ? whole : nullptr;
}

CMPIStatus ProbeAssociators(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result,
                            const CMPIObjectPath* source, const char*, const char*, const char*, const char*,
                            const char**) {
  const CMPIObjectPath* end = farEnd(source);
  if (end) {
    for (const CMPIInstance* instance : Probe::instancesOf(broker, end)) {
      if (Probe::same(end, CMGetObjectPath(instance, nullptr))) {
        CMReturnInstance(result, instance);
      }
    }
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeAssociatorNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result,
                                const CMPIObjectPath* source, const char*, const char*, const char*, const char*) {
  if (const CMPIObjectPath* end = farEnd(source)) {
    CMReturnObjectPath(result, end);
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeReferences(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result,
                           const CMPIObjectPath* source, const char*, const char*, const char**) {
  if (farEnd(source)) {
    CMReturnInstance(result, theLink(source));
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeReferenceNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result,
                               const CMPIObjectPath* source, const char*, const char*) {
  if (farEnd(source)) {
    CMReturnObjectPath(result, CMGetObjectPath(theLink(source), nullptr));
  }
  return CMReturnDone(result);
}

CMPIStatus ProbeMethodCleanup(CMPIMethodMI*, const CMPIContext*, CMPIBoolean) { CMReturn(CMPI_RC_OK); }

// Adds every argument to the output arguments as it came. Returns their names and types, in their order.
CMPIStatus echo(const CMPIResult* result, const CMPIArgs* in, CMPIArgs* out) {
  std::string arrived;
  const CMPICount count = CMGetArgCount(in, nullptr);
  for (CMPICount i = 0; i < count; ++i) {
    CMPIString* name = nullptr;
    const CMPIData data = CMGetArgAt(in, i, &name, nullptr);
    char type[16];
    std::snprintf(type, sizeof type, ":%x ", data.type);
    arrived += CMGetCharsPtr(name, nullptr) + std::string(type);
    CMAddArg(out, CMGetCharsPtr(name, nullptr), CMIsNullValue(data) ? nullptr : &data.value, data.type);
  }
  return CMReturnData(result, arrived.c_str(), CMPI_chars);
}

// Returns the one argument, and adds it to the output arguments.
CMPIStatus copy(const CMPIResult* result, const CMPIArgs* in, CMPIArgs* out) {
  const CMPIData object = CMGetArg(in, "Object", nullptr);
  CMAddArg(out, "Object", &object.value, object.type);
  return CMReturnData(result, &object.value, object.type);
}

CMPIStatus odd(const CMPIResult* result, CMPIArgs* out) {
  const CMPIUint32 number = 7;
  CMAddArg(out, "wide", &number, CMPI_uint32);
  CMAddArg(out, "undeclared", &number, CMPI_uint32);
  return CMReturnData(result, &number, CMPI_uint32);
}

CMPIStatus ProbeInvokeMethod(CMPIMethodMI*, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath*,
                             const char* method, const CMPIArgs* in, CMPIArgs* out) {
  const std::string name = method;
  if (name == "Echo") {
    return echo(result, in, out);
  }
  if (name == "Caller") {
    const CMPIData caller = CMGetContextEntry(context, CMPIPrincipal, nullptr);
    return CMReturnData(result, &caller.value.string, CMPI_string);
  }
  if (name == "Copy") {
    return copy(result, in, out);
  }
  if (name == "Odd") {
    return odd(result, out);
  }
  if (name == "Wrong") {
    return CMReturnData(result, "text", CMPI_chars);
  }
  if (name == "Exit") {
    pthread_exit(nullptr);
  }
  if (name == "Silent") {
    return CMReturnDone(result);
  }
  CMReturnWithChars(broker, CMPI_RC_ERR_METHOD_NOT_AVAILABLE, "not today");
}

}  // namespace

CMInstanceMIStub(Probe, ProbeProvider, broker, CMNoHook)
CMAssociationMIStub(Probe, ProbeProvider, broker, CMNoHook)
CMMethodMIStub(Probe, ProbeProvider, broker, CMNoHook)
