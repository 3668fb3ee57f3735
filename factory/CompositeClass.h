// The six composite classes as data: what each is made of is a row; how an instance is read and made is told once, in
// CompositeInstances.cpp.
#pragma once

#include <QV/ProviderHelper.h>

#include <cstddef>
#include <span>

namespace QV::IPConfigComposite {

struct MappedProperty {
  const char* name;
  DataType type;
};

struct TextProperty {
  const char* name;
  const char* value;
};

// Which underlying instances become composites.
enum class Selection {
  Every,
  OwnedByProcessor,    // "SystemCreationClassName" is the management processor's class, letter case and all
  IdentifierOfFields,  // "InstanceID" has exactly `identifierFields` non-empty fields, the first of them "BMC"
};

// What reading the class does besides copying properties.
enum class Extra {
  None,
  NumberedSystem,  // copies the array "Dedicated", counts "Index" up from 1, and announces every instance
};

// How the getAll member reports its normal end.
enum class Ending {
  ExitLine,
  ExitMarker,  // with the rule line, as a provider operation
};

struct CompositeClass {
  const char* getAll;  // the names of the member pair, as their trace lines show them
  const char* make;

  const char* name;
  const char* underlying;  // the class in root/yrnse that it is composed from
  Selection selection;
  std::size_t identifierFields;

  std::span<const char*> keys;              // null-terminated: what a property filter never hides
  std::span<const TextProperty> constants;  // set on every new instance
  std::span<const MappedProperty> mapped;   // copied from the underlying instance, in this order
  std::span<const TextProperty> finals;     // set after the copy, over whatever is there
  Extra extra;
  Ending ending;
};

extern const CompositeClass computerSystem;
extern const CompositeClass ipProtocolEndpoint;
extern const CompositeClass assignmentSettingSequence;
extern const CompositeClass staticAssignmentSetting;
extern const CompositeClass dhcpAssignmentSetting;
extern const CompositeClass remoteServiceAccessPoint;

}  // namespace QV::IPConfigComposite
