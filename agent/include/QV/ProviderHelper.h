// SPDX-License-Identifier: Apache-2.0
// The management agent's provider helpers (libqvhelper): what the composite providers ask of it.
//
// These declarations are a contract between separately built libraries: another set of libraries with the same symbols
// can stand in place of ours without a rebuild of the providers. Document them; do not add to them.
#pragma once

#include <cmpidt.h>

#include <string>

namespace QV {

// The CIM type under which mapProperty copies a property. The numbers are binding.
enum DataType { Uint16 = 1, Uint8 = 2, String = 8 };

// Copies the property `name` of the instance that `source` carries (source.value.inst) to `target` under the CIM type
// that `type` names. `source` is an enumeration's item: its type says whether it carries an instance, its state says
// nothing, since object managers leave a null state on good items. A property that the source lacks, or holds as null
// or in a type that `type` cannot represent, stays unset in the target. An item of another type, a null instance and a
// null target are left alone, and `status` with them. The outcome of the read or of the set goes to `status`, which may
// be null.
void mapProperty(CMPIData source, CMPIInstance* target, const char* name, DataType type, CMPIStatus* status);

// The managed system's name, used as the host of object paths: the agent's configured name, else the host name.
std::string getSystemName();

// Whether two object paths name the same instance: class and key names without regard to case, the same number of keys,
// values equal by type and value (strings exactly, numbers across integer widths, references by class and keys). Hosts
// never take part. With `flag` the namespaces must agree too if both paths carry one. A null path equals nothing,
// nor does one whose class or keys the object manager does not tell.
bool isObjPathsEqual(const CMPIObjectPath* requested, const CMPIObjectPath* candidate, bool flag);

// Whether two CIM names are equal, ASCII letters without regard to case (DSP0004). A null equals nothing.
bool textEqual(const char* a, const char* b);

}  // namespace QV
