// SPDX-License-Identifier: Apache-2.0
// The model's tables: what the classes and associations are, and what each builder does about a failure.
#pragma once

#include <QV/ProviderHelper.h>

#include <optional>
#include <string>
#include <vector>

namespace Testing::Model {

enum class Chosen { All, OfProcessor, ByIdentifier };

struct Property {
  const char* name;
  QV::DataType type;
};

struct Constant {
  const char* name;
  const char* value;
};

struct Composite {
  const char* name;
  const char* getAll;
  const char* make;
  const char* underlying;
  Chosen chosen;
  unsigned identifierFields;
  std::vector<const char*> keys;  // with its null
  std::vector<Constant> constants;
  std::vector<Property> copied;
  std::optional<Constant> last;  // set over what was copied
};

const Composite& compositeOf(const std::string& name);

// What a builder does: goes on, or ends with a result; with a message, if there is one.
struct Reaction {
  std::optional<int> result;
  std::string message;
  int line = 0;
};

struct Association {
  const char* name;

  // What References answers: which property holds which end.
  const char* propertyA;
  const char* endA;
  const char* propertyB;
  const char* endB;

  // What the builder makes: two properties in the order in which they are set, of an end that is read once and one that
  // is read for each of its instances.
  const char* builder;
  int entryLine = 0;  // any where 0
  int exitLine = 0;
  const char* first;
  const char* second;
  const char* outer;
  const char* inner;
  bool firstHoldsOuter = false;
  bool ordered = false;  // goes by identifiers, and by a word in those of the sequences
  const char* word = "";
  const char* wordOfReferenceNames = "";
  bool keysOnPath = false;
  bool flags = false;  // "IsDefault" and so on

  Reaction outerFails;
  Reaction outerUnusable;
  Reaction innerFails;
  Reaction innerUnusable;
  Reaction pathUnmade;
  bool appendsUnmade;
};

const Association& associationOf(const std::string& name);

// The class at the far end, tested from the first row to the last.
struct FarEnd {
  const char* source;
  const char* association;
  const char* target;
};

extern const std::vector<FarEnd> farEnds;

}  // namespace Testing::Model
