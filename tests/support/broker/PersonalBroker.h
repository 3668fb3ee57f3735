// The embedded object manager's broker with the running personality: what it and every object that it hands out answer
// where object managers differ. All else is the real broker's.
#pragma once

#include <cmpift.h>

#include <set>
#include <string>

namespace Testing {

// One lives at a time.
class PersonalBroker {
 public:
  explicit PersonalBroker(const CMPIBroker* real);
  ~PersonalBroker();
  PersonalBroker(const PersonalBroker&) = delete;
  PersonalBroker& operator=(const PersonalBroker&) = delete;

  const CMPIBroker* broker() const { return &broker_; }

  // Classes that the broker does not know, although the schema has them.
  std::set<std::string> unknownClasses;

 private:
  static CMPIObjectPath* newObjectPath(const CMPIBroker*, const char*, const char*, CMPIStatus*);
  static CMPIInstance* newInstance(const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*);
  static CMPIString* newString(const CMPIBroker*, const char*, CMPIStatus*);
  static CMPIStatus trace(const CMPIBroker*, Cmpi::TraceLevel, const char*, const char*, const CMPIString*);

  CMPIBroker broker_;
  CMPIBrokerFT upCallTable_;
  CMPIBrokerEncFT encapsulation_;
};

}  // namespace Testing
