// SPDX-License-Identifier: Apache-2.0
// The thin layer over CMPI objects that the library shares. Object managers do hand out null strings, null paths and
// wrongly typed values; what would have to follow a null pointer is skipped here, once for all.
#pragma once

#include <cmpimacs.h>

#include <cstdint>
#include <string>
#include <vector>

namespace QV::IPConfigComposite {

// The characters of a string; the empty text for a null string.
const char* textOf(const CMPIString* string, CMPIStatus* status);

// The characters of a value that is flagged non-null and typed as a string or chars; the empty text for any other.
const char* textOf(const CMPIData& data, CMPIStatus* status);

// The path's namespace and class name, and its rendering for the trace; the empty text if there is none.
const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status);
const char* classNameOf(const CMPIObjectPath* path, CMPIStatus* status);
const char* renderingOf(const CMPIObjectPath* path);

// A key of a path and a property of an instance; a null value if the object or the name is missing.
CMPIData keyOf(const CMPIObjectPath* path, const char* name, CMPIStatus* status);
CMPIData propertyOf(const CMPIInstance* instance, const char* name, CMPIStatus* status);

// What an enumeration delivered, fit to be handed on: the instance of an item whose type says that it carries one, a
// null instance for an item of any other type. The item's own state says nothing: OpenPegasus leaves CMPI_nullValue on
// items that carry good instances.
CMPIData instanceItem(const CMPIData& item);

// The instance's object path, null if the instance is.
CMPIObjectPath* pathOf(const CMPIInstance* instance, CMPIStatus* status);

// Sets a text or a reference on an instance that is not null; the outcome is not looked at.
void setText(CMPIInstance* instance, const char* name, const char* text);
void setReference(CMPIInstance* instance, const char* name, const CMPIObjectPath* path);

// Gives a path that is not null the namespace of the request's path and the managed system's name as host: what every
// path that goes to a client carries.
void rehome(CMPIObjectPath* path, const CMPIObjectPath* request, CMPIStatus* status);

// Writes to the object manager's own CMPI trace at a CMPI_LEV_ level.
void traceToBroker(const CMPIBroker* broker, int level, const char* text);

// How many instances a walk visits: their number cut to 16 bits (compatibility 6).
std::uint16_t countOf(const std::vector<CMPIInstance*>& instances);

}  // namespace QV::IPConfigComposite
