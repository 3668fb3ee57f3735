// The seven operations of the six association providers, told once; a unit is a row.
#pragma once

#include <cmpift.h>

#include <string>
#include <vector>

#include "AssociationBuilder.h"

namespace QV::IPConfigComposite {

// How an association that pairs by "InstanceID" decides what belongs together. Seen from end B, an instance of end A is
// associated when its identifier contains both the source's and the operation's kind word; seen from end A, an instance
// of end B when the source's identifier contains the instance's.
struct KindWords {
  const char* associators;
  const char* associatorNames;
  const char* references;
  const char* referenceNames;
};

struct AssociationUnit {
  const std::string& component;  // the unit's logger
  const char* file;              // the unit's name, as its trace lines show it
  const char* associationClass;

  // The two ends and the reference properties that hold them in what References and ReferenceNames answer. (The
  // instances of the builder name theirs themselves.)
  End endA;
  End endB;
  const char* referenceToA;
  const char* referenceToB;

  const KindWords* kindWords;  // null: every far-end instance is associated with every source object
};

// The builder of a unit's association instances with the unit's broker.
using BuildInstances = int (*)(const CMPIObjectPath*, const char**, const CMPIContext*, std::vector<CMPIInstance*>&);

// One call of an operation: the unit, its broker, and the operation's own name for the trace.
struct AssociationCall {
  const AssociationUnit& unit;
  const CMPIBroker* broker;
  const char* function;
};

// The association side answers what lies at the far end of the source object `op`, read afresh, and never calls
// returnDone. Which class that is follows from the source's class and the association class alone: result class, roles
// and property list are not consulted. An association class or a source that the model does not pair answers nothing.
CMPIStatus associators(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char* assocClass, const char* resultClass);
CMPIStatus associatorNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                           const CMPIObjectPath* op, const char* assocClass, const char* resultClass);
CMPIStatus references(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                      const CMPIObjectPath* op);
CMPIStatus referenceNames(const AssociationCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* op);

// The instance side answers what the builder makes, and always ends with returnDone and the exit marker.
CMPIStatus getAssociation(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                          const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);
CMPIStatus enumAssociations(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                            const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);
CMPIStatus enumAssociationNames(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                                const CMPIResult* rslt, const CMPIObjectPath* op);

}  // namespace QV::IPConfigComposite
