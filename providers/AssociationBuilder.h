// The builders of association instances, told once: each pairs the composite instances of an association's two ends.
// What differs between the six, to the last blank of a message, is a row.
#pragma once

#include <cmpift.h>

#include <string>
#include <vector>

#include "IPConfigObjectFactory.h"

namespace QV::IPConfigComposite {

// One end of an association: its class and the factory member that reads it.
struct End {
  const char* className;
  GetAll getAll;
};

// What a builder does when something goes wrong.
struct Reaction {
  enum class Course { GoOn, EndWith0, EndWith1 };

  Course course;
  const char* message = nullptr;         // none where null
  unsigned int line = __builtin_LINE();  // the source line that the message carries
};

// What happens to a pair whose instance the broker could not make.
enum class UnmadeInstance {
  Append,  // the unusable pointer stands in the result
  Skip,
};

struct AssociationBuilder {
  const std::string& component;  // the unit's logger
  const char* file;              // the unit's name, as its trace lines show it
  const char* function;          // the builder's own name
  unsigned int entryLine;
  unsigned int exitLine;

  const char* associationClass;
  End outer;  // read once
  End inner;  // read afresh for every outer instance

  // The two reference properties in the order in which they are set; the first holds the outer or the inner end.
  const char* first;
  const char* second;
  bool firstIsOuter;
  bool keysOnPath;  // the references become keys of the instance's path at once; else the broker derives them

  bool outerIdentifierRead;  // the outer end's "InstanceID" is read, and nothing made of it
  const char* innerMarker;   // the word that the inner end's "InstanceID" must contain, or null to pair everything
  bool settingFlags;         // sets "IsDefault", "IsCurrent" and "IsNext" by the form of the inner end's "InstanceID"

  Reaction outerFailed;
  Reaction outerNull;
  Reaction innerFailed;
  Reaction innerNull;
  Reaction pathFailed;
  UnmadeInstance instanceFailed;
};

// Appends every instance of the association to `out`; on failure those already appended stay. Returns 0 on success and
// 1 on failure. Costs one enumeration of the outer end and one of the inner end for every usable outer instance.
int buildAssociations(const AssociationBuilder& builder, const CMPIBroker* broker, const CMPIObjectPath* ref,
                      const char** properties, const CMPIContext* ctx, std::vector<CMPIInstance*>& out);

}  // namespace QV::IPConfigComposite
