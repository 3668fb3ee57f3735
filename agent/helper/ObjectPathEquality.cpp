// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <cmpimacs.h>

#include <algorithm>
#include <cstring>
#include <optional>
#include <vector>

#include "agent/helper/Conversion.h"

namespace QV {
namespace {

// A key as the broker holds it; its name lives as long as the request.
struct PathKey {
  const char* name;
  CMPIData value;
};

using PathKeys = std::vector<PathKey>;

// Nothing if it cannot be read or has no name: a path with such a key names no instance that can be told. Some object
// managers look a key up by its exact spelling only, so keys are taken by index.
std::optional<PathKey> keyAt(const CMPIObjectPath* path, CMPICount index) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIString* string = nullptr;
  const CMPIData value = CMGetKeyAt(path, index, &string, &status);
  const char* name = textOf(string);
  if (status.rc != CMPI_RC_OK || !name) {
    return std::nullopt;
  }
  return PathKey{name, value};
}

std::optional<CMPICount> keyCountOf(const CMPIObjectPath* path) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPICount count = CMGetKeyCount(path, &status);
  return status.rc == CMPI_RC_OK ? std::optional(count) : std::nullopt;
}

std::optional<PathKeys> keysOf(const CMPIObjectPath* path, CMPICount count) {
  PathKeys keys;
  keys.reserve(count);
  for (CMPICount index = 0; index < count; ++index) {
    const auto key = keyAt(path, index);
    if (!key) {
      return std::nullopt;
    }
    keys.push_back(*key);
  }
  return keys;
}

bool samePath(const CMPIObjectPath* a, const CMPIObjectPath* b);

bool sameText(const char* a, const char* b) { return a && b && std::strcmp(a, b) == 0; }

// Of a value that has no characters.
bool isNull(const CMPIData& data) {
  return !hasValue(data) || data.type == CMPI_string || data.type == CMPI_chars ||
         (data.type == CMPI_ref && CMIsNullObject(data.value.ref)) ||
         (data.type == CMPI_dateTime && CMIsNullObject(data.value.dateTime));
}

bool sameValue(const CMPIData& a, const CMPIData& b) {
  const char* textOfA = textOf(a);
  const char* textOfB = textOf(b);
  if (textOfA || textOfB) {
    return sameText(textOfA, textOfB);
  }
  if (isNull(a) || isNull(b)) {
    return isNull(a) && isNull(b);
  }
  const auto integerOfA = integerOf(a);
  if (integerOfA && integerOfA == integerOf(b)) {
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
      return sameText(textOf(CMGetStringFormat(a.value.dateTime, nullptr)),
                      textOf(CMGetStringFormat(b.value.dateTime, nullptr)));
    default:
      return false;
  }
}

bool hasEqualKey(const PathKeys& keys, const PathKey& wanted) {
  return std::any_of(keys.begin(), keys.end(), [&](const PathKey& key) {
    return textEqual(key.name, wanted.name) && sameValue(key.value, wanted.value);
  });
}

bool holdsAll(const PathKeys& keys, const PathKeys& wanted) {
  return std::all_of(wanted.begin(), wanted.end(), [&](const PathKey& key) { return hasEqualKey(keys, key); });
}

bool sameKeysInAnyOrder(const std::optional<PathKeys>& a, const std::optional<PathKeys>& b) {
  return a && b && holdsAll(*a, *b) && holdsAll(*b, *a);
}

// The paths of one object manager have their keys in one order, and what tells the instances of a class apart, "Name"
// or "InstanceID", at one of its ends: of a candidate that is another one the rest is not looked at.
bool sameKeys(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  const auto count = keyCountOf(a);
  if (!count || count != keyCountOf(b)) {
    return false;
  }
  for (CMPICount turn = 0; turn < *count; ++turn) {
    const CMPICount index = turn == 0 ? 0 : *count - turn;
    const auto keyOfA = keyAt(a, index);
    const auto keyOfB = keyAt(b, index);
    if (!keyOfA || !keyOfB) {
      return false;
    }
    if (!textEqual(keyOfA->name, keyOfB->name)) {
      return sameKeysInAnyOrder(keysOf(a, *count), keysOf(b, *count));
    }
    if (!sameValue(keyOfA->value, keyOfB->value)) {
      return false;
    }
  }
  return true;
}

using NameGetter = CMPIString* (*)(const CMPIObjectPath*, CMPIStatus*);

// A name of the path; null beside an error, whatever the pointer is.
const char* nameOf(const CMPIObjectPath* path, NameGetter getter) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  const CMPIString* name = getter(path, &status);
  return status.rc == CMPI_RC_OK ? textOf(name) : nullptr;
}

// By class and keys, without the namespaces. A path whose class is not known equals nothing.
bool samePath(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  return sameKeys(a, b) && textEqual(nameOf(a, a->ft->getClassName), nameOf(b, b->ft->getClassName));
}

bool sameNamespace(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  const char* nameSpaceOfA = nameOf(a, a->ft->getNameSpace);
  const char* nameSpaceOfB = nameOf(b, b->ft->getNameSpace);
  const auto isAbsent = [](const char* nameSpace) { return !nameSpace || *nameSpace == '\0'; };
  return isAbsent(nameSpaceOfA) || isAbsent(nameSpaceOfB) || textEqual(nameSpaceOfA, nameSpaceOfB);
}

}  // namespace

bool isObjPathsEqual(const CMPIObjectPath* requested, const CMPIObjectPath* candidate, bool flag) {
  if (CMIsNullObject(requested) || CMIsNullObject(candidate)) {
    return false;
  }
  return samePath(requested, candidate) && (!flag || sameNamespace(requested, candidate));
}

}  // namespace QV
