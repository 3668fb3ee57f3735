// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/model/Access.h"

namespace Testing::Model {

std::string charactersOf(const CMPIString* string, CMPIStatus* status) {
  const char* characters = usable(string) ? CMGetCharsPtr(string, status) : nullptr;
  return characters ? characters : "";
}

bool flaggedNull(const CMPIData& data) { return (data.state & 0x100) != 0; }

std::string textIn(const CMPIData& data, CMPIStatus* status) {
  if (flaggedNull(data)) {
    return "";
  }
  if (data.type == CMPI_chars) {
    return data.value.chars ? data.value.chars : "";
  }
  return data.type == CMPI_string ? charactersOf(data.value.string, status) : "";
}

std::string nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status) {
  return charactersOf(CMGetNameSpace(path, status), status);
}

std::string classNameOf(const CMPIObjectPath* path, CMPIStatus* status) {
  return charactersOf(CMGetClassName(path, status), status);
}

std::string textProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status, CMPIStatus* characters) {
  return usable(instance) ? textIn(CMGetProperty(instance, name, status), characters) : "";
}

std::vector<std::string> fieldsOf(const std::string& text) {
  std::vector<std::string> fields;
  std::string field;
  for (const char character : text + ':') {
    if (character != ':') {
      field += character;
    } else if (!field.empty()) {
      fields.push_back(field);
      field.clear();
    }
  }
  return fields;
}

bool holds(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

CMPIObjectPath* pathOf(const CMPIInstance* instance, CMPIStatus* status) {
  return usable(instance) ? CMGetObjectPath(instance, status) : nullptr;
}

}  // namespace Testing::Model
