// SPDX-License-Identifier: Apache-2.0
// The operations of the six association providers, stated once; a unit is a row, in which every deliberate difference
// stands, to the last blank of a message (compatibility 2).
#pragma once

#include <cmpift.h>

#include <string>
#include <vector>

#include "factory/Model.h"

namespace QV::IPConfigComposite {

// The word that the identifier of a sequence must contain to be associated with a setting, by operation.
struct WordInSequence {
  const char* associators;
  const char* associatorNames;
  const char* references;
  const char* referenceNames;
};

// What the builder does when something goes wrong.
struct Reaction {
  enum class Course { GoOn, EndWith0, EndWith1 };

  Course course;
  const char* message;  // none if null
  unsigned int line;    // the source line that the message carries
};

// A line that is not given is the row's own; one that is given is fixed (compatibility 3).
constexpr Reaction goOn() { return {Reaction::Course::GoOn, nullptr, 0}; }
constexpr Reaction endWith0(const char* message = nullptr, unsigned int line = __builtin_LINE()) {
  return {Reaction::Course::EndWith0, message, line};
}
constexpr Reaction endWith1(const char* message = nullptr, unsigned int line = __builtin_LINE()) {
  return {Reaction::Course::EndWith1, message, line};
}
constexpr unsigned int ownLine(unsigned int line = __builtin_LINE()) { return line; }

// What happens to a pair whose instance the broker could not make.
enum class UnmadeInstance {
  Append,  // the unusable pointer stands in the result
  Skip,
};

struct AssociationUnit {
  const Association& association;

  struct Trace {
    const std::string& component;  // the unit's logger
    const char* file;              // the unit's name, as its trace lines show it
    const char* builder;           // the builder's own name
    unsigned int builderEntryLine;
    unsigned int builderExitLine;
  } trace;

  // How the association side decides what belongs together. Null: every far-end instance is associated with every
  // source (compatibility 10). Otherwise identifiers decide: a setting belongs to a sequence whose "InstanceID"
  // contains the setting's. Towards the sequence, it must contain the operation's word besides.
  const WordInSequence* wordInSequence;

  // How the builder pairs the instances of the two ends.
  struct Pairing {
    End outer;                               // read once; the other end is read afresh for every outer instance
    bool readsOuterIdentifier = false;       // compatibility 21
    const char* wordInInnerIdentifier = "";  // that the inner end's "InstanceID" must contain
    bool referencesAreKeys = false;          // compatibility 19: set as keys on the path before the instance is made
    bool setsDefaultCurrentNext = false;     // compatibility 20: by the inner end's "InstanceID"
  } pairing;

  struct OnFailure {
    Reaction outerUnreadable;
    Reaction outerUnusable;  // a null instance, or one without a handle
    Reaction innerUnreadable;
    Reaction innerUnusable;
    Reaction pathUnmade;
    UnmadeInstance instanceUnmade;
  } onFailure;
};

// Appends every instance of the association to `out`; on failure those already appended stay. Returns 0 on success and
// 1 on failure. Costs one enumeration of the outer end and one of the inner end for every usable outer instance.
int buildAssociations(const AssociationUnit& unit, const CMPIBroker* broker, const CMPIObjectPath* ref,
                      const char** properties, const CMPIContext* ctx, std::vector<CMPIInstance*>& out);

// A unit's builder: buildAssociations with the unit and its broker.
using BuildInstances = int (*)(const CMPIObjectPath*, const char**, const CMPIContext*, std::vector<CMPIInstance*>&);

// One call of an operation: the unit, its broker, and the operation's own name for the trace.
struct AssociationCall {
  const AssociationUnit& unit;
  const CMPIBroker* broker;
  const char* function;
};

// The association side returns what lies at the far end of the source object `op`, read afresh, and never calls
// returnDone (compatibility 12). Which class that is follows from the source's class and the association class alone:
// result class, roles and property list are not consulted (compatibility 11). An association class or a source that the
// model does not pair yields nothing.
CMPIStatus associators(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char* assocClass, const char* resultClass);
CMPIStatus associatorNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                           const CMPIObjectPath* op, const char* assocClass, const char* resultClass);
CMPIStatus references(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                      const CMPIObjectPath* op);
CMPIStatus referenceNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* op);

// The instance side returns what the builder makes, and always ends with returnDone and the exit marker.
CMPIStatus getAssociation(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                          const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);
CMPIStatus enumAssociations(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                            const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);
CMPIStatus enumAssociationNames(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                                const CMPIResult* rslt, const CMPIObjectPath* op);

}  // namespace QV::IPConfigComposite
