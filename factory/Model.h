// SPDX-License-Identifier: Apache-2.0
// The model that clients see, stated once: six composite classes and the six associations between them, a row each.
// What is done with a row stands elsewhere, once for all rows: CompositeInstances.cpp reads and makes instances,
// AssociationTargets.cpp finds far ends, providers/operations/ walks the associations.
#pragma once

#include <QV/ProviderHelper.h>

#include <array>
#include <cstddef>
#include <span>

#include "factory/IPConfigObjectFactory.h"

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
  const char* name;
  GetAll getAll;  // the factory's members for it
  Make make;

  const char* underlying;  // the class in root/yrnse that it is composed from
  Selection selection;
  std::size_t identifierFields = 0;

  std::span<const char*> keys;                   // null-terminated: what a property filter never hides
  std::span<const TextProperty> constants = {};  // set on every new instance
  std::span<const MappedProperty> mapped;        // copied from the underlying instance, in this order
  std::span<const TextProperty> finals = {};     // set after the copy, over whatever is there
  Extra extra = Extra::None;
  Ending ending = Ending::ExitLine;
};

extern const CompositeClass computerSystem;
extern const CompositeClass ipProtocolEndpoint;
extern const CompositeClass assignmentSettingSequence;
extern const CompositeClass staticAssignmentSetting;
extern const CompositeClass dhcpAssignmentSetting;
extern const CompositeClass remoteServiceAccessPoint;

enum class End { A, B };

constexpr End otherThan(End end) { return end == End::A ? End::B : End::A; }

// A reference property and the end that it holds.
struct Reference {
  const char* name;
  End end;
};

// The two reference properties of an association, in the order in which they are set.
using References = std::array<Reference, 2>;

struct Association {
  const char* name;
  const CompositeClass& endA;
  const CompositeClass& endB;
  References references;            // of what References and ReferenceNames answer
  References referencesOfInstance;  // of what the builder makes: the same, but for one association (compatibility 9)

  const CompositeClass& classAt(End end) const { return end == End::A ? endA : endB; }
};

extern const Association hostedAccessPoint;
extern const Association remoteHostedAccessPoint;
extern const Association clientAccess;
extern const Association elementSettingData;
extern const Association staticOrderedMember;
extern const Association dhcpOrderedMember;

// An association as it is seen from one of its ends.
struct View {
  const Association& association;
  End source;

  const CompositeClass& sourceClass() const { return association.classAt(source); }
  const CompositeClass& farClass() const { return association.classAt(otherThan(source)); }
};

// All of them, in the order in which a source is held against them.
extern const std::span<const View> views;

}  // namespace QV::IPConfigComposite
