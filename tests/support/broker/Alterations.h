// SPDX-License-Identifier: Apache-2.0
// Objects of the broker that answer otherwise than the broker made them: each keeps its own table, replaced in part.
#pragma once

#include <cmpimacs.h>

#include <string>
#include <vector>

namespace Testing {

// getProperty answers `data` with the code `rc` for the name.
CMPIInstance* withProperty(CMPIInstance* instance, const std::string& name, CMPIData data, CMPIrc rc = CMPI_RC_OK);
// getObjectPath answers `path`.
CMPIInstance* withPath(CMPIInstance* instance, CMPIObjectPath* path);
// The calls of getObjectPath are counted.
CMPIInstance* withPathsCounted(CMPIInstance* instance, int& count);
// "setPropertyFilter(list or null; keys)" and "setProperty(name)" are appended to `calls`.
CMPIInstance* withCallsRecorded(CMPIInstance* instance, std::vector<std::string>& calls);

// getKey answers `data` with the code `rc` for the name.
CMPIObjectPath* withKey(CMPIObjectPath* path, const std::string& name, CMPIData data, CMPIrc rc = CMPI_RC_OK);
// getKeyCount answers 0.
CMPIObjectPath* countingNoKeys(CMPIObjectPath* path);
// getKeyCount leaves the status as it is, which object managers may where nothing is wrong.
CMPIObjectPath* countingKeysQuietly(CMPIObjectPath* path);
// The names that getKey is asked for are appended to `names`.
CMPIObjectPath* withKeysRecorded(CMPIObjectPath* path, std::vector<std::string>& names);

// One of the texts of a path.
using PathText = decltype(CMPIObjectPathFT::getHostname) CMPIObjectPathFT::*;
// The slot answers `string`.
CMPIObjectPath* withText(CMPIObjectPath* path, PathText slot, CMPIString* string);

// The characters are read with the code `rc`.
CMPIString* withCode(CMPIString* string, CMPIrc rc);

// Objects whose handle is null.
CMPIInstance* withoutHandle();
CMPIObjectPath* pathWithoutHandle();

// What stands for a text without characters: a null string, one without a handle, and two whose characters are null,
// with an error and without one.
std::vector<CMPIString*> stringsWithoutCharacters();

}  // namespace Testing
