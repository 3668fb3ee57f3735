// A broker whose up-calls a test scripts and whose makers a test can make fail. Everything else is the real broker's,
// with the running personality.
#pragma once

#include <cmpimacs.h>

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "tests/support/broker/Alterations.h"
#include "tests/support/broker/PersonalBroker.h"

namespace Testing {

// What the enumeration of one underlying class answers.
struct UpCallScript {
  std::vector<CMPIInstance*> instances;  // null elements are answered as they are
  std::vector<CMPIData> items;           // answered after the instances, as they are
  // An error comes with an empty enumeration or without one, as the personality has it.
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  bool nullEnumeration = false;
};

struct UpCall {
  std::string nameSpace;
  std::string className;
  bool hasPropertyList;

  bool operator==(const UpCall&) const = default;
};

struct BrokerTrace {
  int level;
  std::string component;
  std::string text;

  bool operator==(const BrokerTrace&) const = default;
};

// Copies the broker with its tables and puts itself in front of the slots below. One lives at a time.
class FaultyBroker {
 public:
  explicit FaultyBroker(const CMPIBroker* real);
  ~FaultyBroker();
  FaultyBroker(const FaultyBroker&) = delete;
  FaultyBroker& operator=(const FaultyBroker&) = delete;

  const CMPIBroker* broker() const { return &broker_; }
  // The same object manager without scripts and failures.
  const CMPIBroker* real() const { return personal_.broker(); }

  // Makes the object manager forget a class that the schema has.
  void forgetClass(const std::string& className) { personal_.unknownClasses.insert(className); }

  std::map<std::string, UpCallScript> upCallScripts;  // by underlying class
  // Called before an up-call is answered; may change the script.
  std::function<void(const UpCall&)> onUpCall;
  std::vector<UpCall> upCalls;
  int readsPastTheEnd = 0;  // of enumerations
  std::vector<BrokerTrace> traces;
  std::vector<std::string> strings;  // the texts that newString was asked for

  // Whether the maker answers null for a class: asked with the class name and the number of the call for it, from 1.
  std::function<bool(const std::string& className, int call)> failNewObjectPath;
  std::function<bool(const std::string& className, int call)> failNewInstance;
  bool failNewArray = false;
  // What a maker answers that a test makes fail.
  CMPIObjectPath* unmadePath = nullptr;
  CMPIInstance* unmadeInstance = nullptr;
  // Called with every instance that is made, to alter it; asked as the makers are.
  std::function<void(const std::string& className, int call, CMPIInstance* instance)> onNewInstance;
  // By class, what was done with the instances that were made, in order: "newInstance(keys of the path)",
  // "setPropertyFilter(list or null; keys)", "setProperty(name)".
  std::map<std::string, std::vector<std::string>> instanceCalls;

 private:
  static CMPIEnumeration* enumerateInstances(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**,
                                             CMPIStatus*);
  static CMPIObjectPath* newObjectPath(const CMPIBroker*, const char*, const char*, CMPIStatus*);
  static CMPIInstance* newInstance(const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*);
  static CMPIArray* newArray(const CMPIBroker*, CMPICount, CMPIType, CMPIStatus*);
  static CMPIString* newString(const CMPIBroker*, const char*, CMPIStatus*);
  static CMPIStatus trace(const CMPIBroker*, Cmpi::TraceLevel, const char*, const char*, const CMPIString*);

  PersonalBroker personal_;
  CMPIBroker broker_;
  CMPIBrokerFT upCallTable_;
  CMPIBrokerEncFT encapsulation_;
  std::map<std::string, int> newObjectPathCalls_;
  std::map<std::string, int> newInstanceCalls_;
};

// Keeps what a provider delivers.
class RecordingResult {
 public:
  RecordingResult();
  RecordingResult(const RecordingResult&) = delete;
  RecordingResult& operator=(const RecordingResult&) = delete;
  const CMPIResult* result() const { return &result_; }

  std::vector<const CMPIInstance*> instances;
  std::vector<const CMPIObjectPath*> paths;
  int done = 0;
  std::vector<std::string> order;  // "instance", "path", "done"

 private:
  CMPIResult result_;
};

}  // namespace Testing
