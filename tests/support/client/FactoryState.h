// SPDX-License-Identifier: Apache-2.0
// What the composite shows of a simulated management processor in its factory state, as wbemcli prints it: the
// instances of each class with their values, and how the associations relate them.
#pragma once

#include <iosfwd>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/Classes.h"

namespace Testing {

using Values = std::map<std::string, std::string>;
using Objects = std::vector<std::string>;

// A class, the objects that it has, and what each of them shows. Values that the schema gives by default show too.
struct ClassCase {
  std::string className;
  Objects objects;
  std::vector<Values> values;
};

void PrintTo(const ClassCase& row, std::ostream* stream);

// The six classes that are no associations.
std::vector<ClassCase> classCases();

// What one end sees through one association: the far ends that Associators, AssociatorNames and References answer, and
// those that ReferenceNames answers, which are the same except where said otherwise.
struct View {
  const char* association;
  std::string source;
  Objects far;
  Objects referenceNames = far;
};

// Each association from each end.
std::vector<View> views();

// An association class and the pairs that its enumeration answers, in order.
struct Enumeration {
  const char* association;
  const char* first;
  const char* second;
  std::vector<std::pair<std::string, std::string>> pairs;
};

void PrintTo(const Enumeration& row, std::ostream* stream);

std::vector<Enumeration> enumerations();

}  // namespace Testing
