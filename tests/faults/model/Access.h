// SPDX-License-Identifier: Apache-2.0
// How the model reads what an object manager hands out.
#pragma once

#include <cmpimacs.h>

#include <string>
#include <vector>

namespace Testing::Model {

// What cannot be followed: a null pointer, or an object whose handle is null. A call that would have to be made on one
// is left out, and what it would have answered is empty.
template <typename Object>
bool usable(const Object* object) {
  return object && object->hdl;
}

bool flaggedNull(const CMPIData& data);

// A text, of a value that is not flagged null and is one, as a string or as bare characters.
std::string textIn(const CMPIData& data, CMPIStatus* status);
std::string charactersOf(const CMPIString* string, CMPIStatus* status);

std::string nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status);
std::string classNameOf(const CMPIObjectPath* path, CMPIStatus* status);
CMPIObjectPath* pathOf(const CMPIInstance* instance, CMPIStatus* status);

// A property's text; `status` takes the code of the read, `characters` that of the conversion.
std::string textProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status, CMPIStatus* characters);

// The fields of an identifier between its colons; empty ones vanish.
std::vector<std::string> fieldsOf(const std::string& text);

bool holds(const std::string& text, const std::string& part);

}  // namespace Testing::Model
