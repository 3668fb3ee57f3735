// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <vector>

#include "cimom/interop/InteropModel.h"
#include "cimom/providers/ProviderRegistration.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom {

// A provider that is linked into the program, and what it serves.
struct LinkedProvider {
  std::vector<ProviderRegistration> registrations;
  InstanceFactory instanceFactory;
  AssociationFactory associationFactory;
};

// What clients ask an object manager about itself (DSP1033): CIM_ObjectManager, CIM_Namespace, CIM_RegisteredProfile
// and the associations between them and with what conforms, in the namespace root/interop. Every instance is made
// afresh from the class repository, which must outlive its use, and the profiles; nothing can be written. Classes that
// the schema lacks are not registered, and none without CIM_ObjectManager and CIM_Namespace, of which all others speak.
LinkedProvider interopProvider(const ClassRepository& classes, InteropFacts facts);

}  // namespace Cimom
