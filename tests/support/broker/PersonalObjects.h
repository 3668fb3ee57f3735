// SPDX-License-Identifier: Apache-2.0
// The objects of the embedded object manager with the function tables of the running personality.
#pragma once

#include <cmpift.h>

#include "cimom/model/ClassDefinition.h"

namespace Testing {

// The object with the personality's table; as it is if it has none of the object manager's own tables, or is null.
CMPIString* personal(CMPIString* string);
CMPIObjectPath* personal(CMPIObjectPath* path);
CMPIInstance* personal(CMPIInstance* instance);
// The message of a status, which may be null.
void personalize(CMPIStatus* status);

// A string of the broker without characters.
CMPIString* stringWithoutCharacters();

// The path on which an object manager makes an instance, or which it keeps as a reference, where hosts are lost there.
Cimom::ObjectPath withoutHost(const Cimom::ObjectPath& path);

// Adds the keys of the class that the path lacks, as nulls.
void addUnsetKeys(Cimom::ObjectPath& path, const Cimom::ClassDefinition& definition);

// An instance of a class that the object manager does not know.
CMPIInstance* instanceOfUnknownClass(const Cimom::ObjectPath& path);
// Sets the keys of the path that the instance's class does not declare, where undeclared properties are kept.
void keepUndeclaredKeys(const CMPIInstance* instance, const Cimom::ObjectPath& path);

// Forgets what is kept of single instances.
void forgetInstances();

}  // namespace Testing
