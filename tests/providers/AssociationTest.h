// SPDX-License-Identifier: Apache-2.0
// The fixture of the association tests: an attached association provider, underlying instances by the names of the
// composites that they yield, and what an operation delivered, in texts that a test compares.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tests/support/composite/AssociationModel.h"
#include "tests/support/composite/CompositeTest.h"
#include "tests/support/composite/RefusedReading.h"
#include "tests/support/composite/Samples.h"
#include "tests/support/composite/Units.h"

namespace Testing {

enum class Navigation { Associators, AssociatorNames, References, ReferenceNames };
enum class Reading { GetInstance, EnumInstances, EnumInstanceNames };

inline constexpr Navigation navigations[] = {Navigation::Associators, Navigation::AssociatorNames,
                                             Navigation::References, Navigation::ReferenceNames};
inline constexpr Reading readings[] = {Reading::GetInstance, Reading::EnumInstances, Reading::EnumInstanceNames};

std::string nameOf(Navigation navigation);
std::string nameOf(Reading reading);

// What an operation delivered.
struct Answer {
  CMPIStatus status;
  std::vector<const CMPIInstance*> instances;
  std::vector<const CMPIObjectPath*> paths;
  Strings order;
};

class AssociationTest : public CompositeTest {
 protected:
  AssociationTest() { refuseNextReading(""); }

  // Makes the broker of the test that of the association's provider.
  void attach(const AssociationModel& model);

  // Adds underlying instances that yield composites of the class, each with that "Name" or "InstanceID".
  void add(const std::string& compositeClass, const Strings& names);
  CMPIInstance* add(const std::string& compositeClass, const std::string& name);
  // Both ends of what the builder pairs.
  void addEnds(const Strings& outerNames, const Strings& innerNames);

  // The path of a composite as a client sends it.
  CMPIObjectPath* clientPath(const std::string& compositeClass, const std::string& name);

  // An association operation of the attached provider. The association class is the provider's own unless given.
  Answer navigate(Navigation navigation, const CMPIObjectPath* source);
  Answer navigate(Navigation navigation, const CMPIObjectPath* source, const char* associationClass);
  Answer read(Reading reading, const CMPIObjectPath* path, const char** properties = nullptr);
  // The attached association's builder.
  int build(std::vector<CMPIInstance*>& out, const char** properties = nullptr);

  // The lines of the attached unit in the log, in order, without those of the factory and without their line numbers.
  Strings unitLines() const;
  // The four lines, in that shape, that frame an operation that says nothing else.
  Strings framed(const std::string& function) const;
  // The frame of an operation that breaks off with a message.
  Strings brokenOff(const std::string& function, const std::string& message) const;
  std::string messageLine(const std::string& message) const;

  Strings underlyingCalls() const;  // the classes of the up-calls, in order
  // Makes the reading of the composite class of that number, from 1, fail; each reading before it makes an up-call.
  void refuseReading(const std::string& compositeClass, int number);
  // Makes `unusable` what comes of the composite of that number, from 1.
  void spoil(const std::string& compositeClass, int number, CMPIInstance* unusable);

  const AssociationModel& model() const { return *model_; }
  const Unit& unit() const { return *unit_; }

 private:
  const AssociationModel* model_ = nullptr;
  const Unit* unit_ = nullptr;
  CMPIInstanceMI* instances_ = nullptr;
  CMPIAssociationMI* associations_ = nullptr;
};

std::string underlyingClassOf(const std::string& compositeClass);
const char* keyOf(const std::string& compositeClass);

// "//host/namespace:Class=name" of a path to a composite; "(none)" where there is no path.
std::string render(const CMPIObjectPath* path);
// The same of a composite with the system's name and the request's namespace: of its path in the answer to a request
// for names, of its instance's path, and of a reference to it. The library homes all three; an object manager may lose
// the host of the latter two.
std::string homed(const std::string& compositeClass, const std::string& name);
std::string homedInstance(const std::string& compositeClass, const std::string& name);
std::string homedReference(const std::string& compositeClass, const std::string& name);
std::string rendered(const std::string& host, const std::string& nameSpace, const std::string& compositeClass,
                     const std::string& name);

// A key that is a reference; null if there is none.
const CMPIObjectPath* referenceKey(const CMPIObjectPath* path, const std::string& name);

// "first -> second" of the two references of an association instance, or of the two keys of its path.
std::string renderPair(const CMPIInstance* instance, const std::string& first, const std::string& second);
std::string renderPair(const CMPIObjectPath* path, const std::string& first, const std::string& second);

}  // namespace Testing
