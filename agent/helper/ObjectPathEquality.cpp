// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <cmpimacs.h>

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

#include "agent/helper/Conversion.h"

namespace QV {
namespace {

struct Key {
  std::string name;
  CMPIData value;
};

using Keys = std::vector<Key>;

// Nothing if they cannot be read, or one of them has no name: such a path names no instance that can be told.
// Some object managers look a key up by its exact spelling only, so the keys are taken by index.
std::optional<Keys> keysOf(const CMPIObjectPath* path) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPICount count = CMGetKeyCount(path, &status);
  Keys keys;
  for (CMPICount index = 0; status.rc == CMPI_RC_OK && index < count; ++index) {
    CMPIString* string = nullptr;
    const CMPIData value = CMGetKeyAt(path, index, &string, &status);
    const auto name = textOf(string);
    if (!name) {
      return std::nullopt;
    }
    keys.push_back({*name, value});
  }
  if (status.rc != CMPI_RC_OK) {
    return std::nullopt;
  }
  return keys;
}

bool samePath(const CMPIObjectPath* a, const CMPIObjectPath* b);

template <typename Optional>
bool bothEqual(const Optional& a, const Optional& b) {
  return a && b && *a == *b;
}

bool isNull(const CMPIData& data) {
  return !hasValue(data) || (data.type == CMPI_string && !textOf(data.value.string)) ||
         (data.type == CMPI_chars && !data.value.chars) || (data.type == CMPI_ref && CMIsNullObject(data.value.ref)) ||
         (data.type == CMPI_dateTime && CMIsNullObject(data.value.dateTime));
}

bool sameValue(const CMPIData& a, const CMPIData& b) {
  if (isNull(a) || isNull(b)) {
    return isNull(a) && isNull(b);
  }
  if (bothEqual(integerOf(a), integerOf(b)) || bothEqual(textOf(a), textOf(b))) {
    return true;
  }
  if (a.type != b.type) {
    return false;
  }
  switch (a.type) {
    case CMPI_boolean:
      return (a.value.boolean != 0) == (b.value.boolean != 0);
    case CMPI_char16:
      return a.value.char16 == b.value.char16;
    case CMPI_real32:
      return a.value.real32 == b.value.real32;
    case CMPI_real64:
      return a.value.real64 == b.value.real64;
    case CMPI_ref:
      return samePath(a.value.ref, b.value.ref);
    case CMPI_dateTime:
      return bothEqual(textOf(CMGetStringFormat(a.value.dateTime, nullptr)),
                       textOf(CMGetStringFormat(b.value.dateTime, nullptr)));
    default:
      return false;
  }
}

bool hasEqualKey(const Keys& keys, const Key& wanted) {
  return std::any_of(keys.begin(), keys.end(), [&](const Key& key) {
    return textEqual(key.name.c_str(), wanted.name.c_str()) && sameValue(key.value, wanted.value);
  });
}

bool holdsAll(const Keys& keys, const Keys& wanted) {
  return std::all_of(wanted.begin(), wanted.end(), [&](const Key& key) { return hasEqualKey(keys, key); });
}

bool sameKeys(const std::optional<Keys>& a, const std::optional<Keys>& b) {
  return a && b && a->size() == b->size() && holdsAll(*a, *b) && holdsAll(*b, *a);
}

// A name as it was read; nothing beside an error, whatever the pointer is.
std::optional<std::string> asRead(const CMPIString* name, const CMPIStatus& status) {
  return status.rc == CMPI_RC_OK ? textOf(name) : std::nullopt;
}

std::optional<std::string> classOf(const CMPIObjectPath* path) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIString* name = CMGetClassName(path, &status);
  return asRead(name, status);
}

std::string namespaceOf(const CMPIObjectPath* path) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIString* name = CMGetNameSpace(path, &status);
  return asRead(name, status).value_or("");
}

// By class and keys, without the namespaces. A path whose class is not known equals nothing.
bool samePath(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  const auto classOfA = classOf(a);
  const auto classOfB = classOf(b);
  return classOfA && classOfB && textEqual(classOfA->c_str(), classOfB->c_str()) && sameKeys(keysOf(a), keysOf(b));
}

bool sameNamespace(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  const std::string namespaceOfA = namespaceOf(a);
  const std::string namespaceOfB = namespaceOf(b);
  return namespaceOfA.empty() || namespaceOfB.empty() || textEqual(namespaceOfA.c_str(), namespaceOfB.c_str());
}

}  // namespace

bool isObjPathsEqual(const CMPIObjectPath* requested, const CMPIObjectPath* candidate, bool flag) {
  if (CMIsNullObject(requested) || CMIsNullObject(candidate)) {
    return false;
  }
  return samePath(requested, candidate) && (!flag || sameNamespace(requested, candidate));
}

}  // namespace QV
