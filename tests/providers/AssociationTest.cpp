// SPDX-License-Identifier: Apache-2.0
#include "tests/providers/AssociationTest.h"

#include <stdexcept>

#include "tests/support/system/Pattern.h"

namespace Testing {

namespace {

const std::string rule(78, '=');

}  // namespace

std::string nameOf(Navigation navigation) {
  switch (navigation) {
    case Navigation::Associators:
      return "Associators";
    case Navigation::AssociatorNames:
      return "AssociatorNames";
    case Navigation::References:
      return "References";
    case Navigation::ReferenceNames:
      return "ReferenceNames";
  }
  return {};
}

std::string nameOf(Reading reading) {
  switch (reading) {
    case Reading::GetInstance:
      return "GetInstance";
    case Reading::EnumInstances:
      return "EnumInstances";
    case Reading::EnumInstanceNames:
      return "EnumInstanceNames";
  }
  return {};
}

void AssociationTest::attach(const AssociationModel& model) {
  model_ = &model;
  unit_ = &unitOf(model.className);
  instances_ = unit_->createInstanceMI(broker(), context(), &status);
  associations_ = unit_->createAssociationMI(broker(), context(), &status);
}

CMPIInstance* AssociationTest::add(const std::string& compositeClass, const std::string& name) {
  const Sample& sample = sampleOf(compositeClass);
  Properties properties = {{sample.keys.back(), name}};
  if (sample.keys.front() == "SystemCreationClassName") {
    properties.emplace_back("SystemCreationClassName", sampleOf(Classes::computerSystem).underlying);
    properties.emplace_back("SystemName", "bmc0");
  }
  return addUnderlying(sample.underlying, properties);
}

void AssociationTest::add(const std::string& compositeClass, const Strings& names) {
  for (const std::string& name : names) {
    add(compositeClass, name);
  }
}

void AssociationTest::addEnds(const Strings& outerNames, const Strings& innerNames) {
  add(model().outer, outerNames);
  add(model().inner, innerNames);
}

CMPIObjectPath* AssociationTest::clientPath(const std::string& compositeClass, const std::string& name) {
  return makePath(compositeClass, {{keyOf(compositeClass), name}});
}

Answer AssociationTest::navigate(Navigation navigation, const CMPIObjectPath* source) {
  return navigate(navigation, source, model().className.c_str());
}

Answer AssociationTest::navigate(Navigation navigation, const CMPIObjectPath* source, const char* associationClass) {
  // What the operations do not consult names what does not exist.
  constexpr const char* ignored = "NoSuchThing";
  const char* properties[] = {ignored, nullptr};
  const CMPIAssociationMIFT& table = *associations_->ft;
  RecordingResult result;
  CMPIStatus outcome = {CMPI_RC_ERR_FAILED, nullptr};
  switch (navigation) {
    case Navigation::Associators:
      outcome = table.associators(associations_, context(), result.result(), source, associationClass, ignored, ignored,
                                  ignored, properties);
      break;
    case Navigation::AssociatorNames:
      outcome = table.associatorNames(associations_, context(), result.result(), source, associationClass, ignored,
                                      ignored, ignored);
      break;
    case Navigation::References:
      outcome = table.references(associations_, context(), result.result(), source, ignored, ignored, properties);
      break;
    case Navigation::ReferenceNames:
      outcome = table.referenceNames(associations_, context(), result.result(), source, ignored, ignored);
      break;
  }
  return {outcome, result.instances, result.paths, result.order};
}

Answer AssociationTest::read(Reading reading, const CMPIObjectPath* path, const char** properties) {
  const CMPIInstanceMIFT& table = *instances_->ft;
  RecordingResult result;
  CMPIStatus outcome = {CMPI_RC_ERR_FAILED, nullptr};
  switch (reading) {
    case Reading::GetInstance:
      outcome = table.getInstance(instances_, context(), result.result(), path, properties);
      break;
    case Reading::EnumInstances:
      outcome = table.enumerateInstances(instances_, context(), result.result(), path, properties);
      break;
    case Reading::EnumInstanceNames:
      outcome = table.enumerateInstanceNames(instances_, context(), result.result(), path);
      break;
  }
  return {outcome, result.instances, result.paths, result.order};
}

int AssociationTest::build(std::vector<CMPIInstance*>& out, const char** properties) {
  return model().build(makePath(model().className), properties, context(), out);
}

Strings AssociationTest::unitLines() const {
  static const Pattern lineNumber("(\\[|, )Line: [0-9]+");
  Strings lines;
  for (const LogLine& line : logLines()) {
    if (line.channel == Channel::Log && line.component == unit().component) {
      lines.push_back(lineNumber.replaced(line.message, "$1Line: N"));
    }
  }
  return lines;
}

Strings AssociationTest::framed(const std::string& function) const {
  const std::string text = function + "() in " + unit().file + " [Line: N]";
  return {rule, "ENTERING: " + text, "EXITING: " + text, rule};
}

Strings AssociationTest::brokenOff(const std::string& function, const std::string& message) const {
  Strings lines = framed(function);
  lines.resize(2);
  if (!message.empty()) {
    lines.push_back(messageLine(message));
  }
  return lines;
}

std::string AssociationTest::messageLine(const std::string& message) const {
  return "MESSAGE [File: " + unit().file + ", Line: N]: " + message;
}

Strings AssociationTest::underlyingCalls() const {
  Strings classes;
  for (const UpCall& call : faults.upCalls) {
    classes.push_back(call.className);
    EXPECT_EQ(call.nameSpace, "root/yrnse");
    EXPECT_FALSE(call.hasPropertyList);
  }
  return classes;
}

void AssociationTest::refuseReading(const std::string& compositeClass, int number) {
  if (number == 1) {
    refuseNextReading(compositeClass);
    return;
  }
  faults.onUpCall = [=, this, underlying = underlyingClassOf(compositeClass)](const UpCall& call) {
    if (call.className == underlying && upCallsFor(underlying) == number - 1) {
      refuseNextReading(compositeClass);
    }
  };
}

void AssociationTest::spoil(const std::string& compositeClass, int number, CMPIInstance* unusable) {
  faults.unmadeInstance = unusable;
  faults.failNewInstance = [=](const std::string& className, int call) {
    return className == compositeClass && call == number;
  };
}

std::string underlyingClassOf(const std::string& compositeClass) { return sampleOf(compositeClass).underlying; }

const char* keyOf(const std::string& compositeClass) { return sampleOf(compositeClass).keys.back().c_str(); }

std::string rendered(const std::string& host, const std::string& nameSpace, const std::string& compositeClass,
                     const std::string& name) {
  return "//" + host + "/" + nameSpace + ":" + compositeClass + "=" + name;
}

std::string render(const CMPIObjectPath* path) {
  return !path ? text(static_cast<const CMPIString*>(nullptr))
               : rendered(hostOf(path), nameSpaceOf(path), classOf(path), key(path, keyOf(classOf(path))));
}

std::string homed(const std::string& compositeClass, const std::string& name) {
  return rendered(systemName(), requestNameSpace, compositeClass, name);
}

std::string homedInstance(const std::string& compositeClass, const std::string& name) {
  return rendered(hostOfInstance(systemName()), requestNameSpace, compositeClass, name);
}

std::string homedReference(const std::string& compositeClass, const std::string& name) {
  return rendered(hostOfReference(systemName()), requestNameSpace, compositeClass, name);
}

std::string renderPair(const CMPIInstance* instance, const std::string& first, const std::string& second) {
  return render(reference(instance, first)) + " -> " + render(reference(instance, second));
}

const CMPIObjectPath* referenceKey(const CMPIObjectPath* path, const std::string& name) {
  const CMPIData data = CMGetKey(path, name.c_str(), nullptr);
  return CMIsNullValue(data) || data.type != CMPI_ref ? nullptr : data.value.ref;
}

std::string renderPair(const CMPIObjectPath* path, const std::string& first, const std::string& second) {
  return render(referenceKey(path, first)) + " -> " + render(referenceKey(path, second));
}

}  // namespace Testing
