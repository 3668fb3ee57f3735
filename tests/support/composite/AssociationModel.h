// SPDX-License-Identifier: Apache-2.0
// What each of the six associations must do: the tests' own statement, which shares nothing with the product's.
#pragma once

#include <cmpift.h>

#include <functional>
#include <iosfwd>
#include <string>
#include <vector>

#include "tests/support/Classes.h"

namespace Testing {

using Strings = std::vector<std::string>;

// What a builder does about a failure.
struct Outcome {
  enum class Course { GoesOn, Ends };

  Course course;
  int result = 0;
  std::string message = {};  // none where empty
  int line = 0;              // that the message carries; any where 0
};

using Build = std::function<int(const CMPIObjectPath*, const char**, const CMPIContext*, std::vector<CMPIInstance*>&)>;

struct AssociationModel {
  std::string className;

  // The ends that the association operations walk between, and the reference properties that they fill.
  std::string endA;
  std::string endB;
  std::string referenceToA;
  std::string referenceToB;
  bool pairsByIdentifier;

  // The builder of the instances.
  std::string builderName;
  Build build;
  std::string outer;
  std::string inner;
  std::string propertyOfOuter;
  std::string propertyOfInner;
  std::string keysOfPath;                  // that a new instance is made on
  std::string filterKeys;                  // that the property filter spares
  std::vector<std::string> propertiesSet;  // in this order
  std::vector<std::string> outerNames;     // of instances that all pair
  std::vector<std::string> innerNames;
  int entryLine;  // any where 0
  int exitLine;

  Outcome outerFails;
  Outcome outerIsUnusable;
  Outcome innerFails;
  Outcome innerIsUnusable;
  Outcome pathFails;
  bool appendsUnmadeInstance;
};

const std::vector<AssociationModel>& associationModels();
const AssociationModel& modelOf(const std::string& className);

// One of them as a test's parameter, which is copied for every case.
struct AssociationParameter {
  const AssociationModel* model;
};
std::vector<AssociationParameter> associationParameters();
std::ostream& operator<<(std::ostream& stream, const AssociationParameter& parameter);

}  // namespace Testing
