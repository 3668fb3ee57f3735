#include <cmpimacs.h>

#include <vector>

#include "QV/ProviderHelper.h"
#include "helper/Conversion.h"

namespace QV {
namespace {

struct Key {
  std::string name;
  CMPIData value;
};

// Some object managers look a key up by its exact spelling only, so the keys are taken by index.
std::vector<Key> keysOf(const CMPIObjectPath* path) {
  std::vector<Key> keys;
  const CMPICount count = CMGetKeyCount(path, nullptr);
  for (CMPICount index = 0; index < count; ++index) {
    CMPIString* name = nullptr;
    const CMPIData value = CMGetKeyAt(path, index, &name, nullptr);
    keys.push_back({charactersOf(name), value});
  }
  return keys;
}

bool samePath(const CMPIObjectPath* a, const CMPIObjectPath* b);

template <typename Optional>
bool bothEqual(const Optional& a, const Optional& b) {
  return a && b && *a == *b;
}

bool isNull(const CMPIData& data) {
  return CMIsNullValue(data) || (data.type == CMPI_string && CMIsNullObject(data.value.string)) ||
         (data.type == CMPI_chars && !data.value.chars) || (data.type == CMPI_ref && CMIsNullObject(data.value.ref)) ||
         (data.type == CMPI_dateTime && CMIsNullObject(data.value.dateTime));
}

bool sameValue(const CMPIData& a, const CMPIData& b) {
  if (isNull(a) || isNull(b)) return isNull(a) && isNull(b);
  if (bothEqual(integerOf(a), integerOf(b)) || bothEqual(textOf(a), textOf(b))) return true;
  if (a.type != b.type) return false;
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
      return charactersOf(CMGetStringFormat(a.value.dateTime, nullptr)) ==
             charactersOf(CMGetStringFormat(b.value.dateTime, nullptr));
    default:
      return false;
  }
}

bool hasEqualKey(const std::vector<Key>& keys, const Key& wanted) {
  for (const Key& key : keys) {
    if (textEqual(key.name.c_str(), wanted.name.c_str())) return sameValue(key.value, wanted.value);
  }
  return false;
}

// By class and keys, without the namespaces.
bool samePath(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  if (!textEqual(charactersOf(CMGetClassName(a, nullptr)).c_str(), charactersOf(CMGetClassName(b, nullptr)).c_str()))
    return false;
  const auto keysOfA = keysOf(a);
  const auto keysOfB = keysOf(b);
  if (keysOfA.size() != keysOfB.size()) return false;
  for (const Key& key : keysOfA) {
    if (!hasEqualKey(keysOfB, key)) return false;
  }
  return true;
}

bool sameNamespace(const CMPIObjectPath* a, const CMPIObjectPath* b) {
  const std::string namespaceOfA = charactersOf(CMGetNameSpace(a, nullptr));
  const std::string namespaceOfB = charactersOf(CMGetNameSpace(b, nullptr));
  return namespaceOfA.empty() || namespaceOfB.empty() || textEqual(namespaceOfA.c_str(), namespaceOfB.c_str());
}

}  // namespace

bool isObjPathsEqual(const CMPIObjectPath* requested, const CMPIObjectPath* candidate, bool flag) {
  if (CMIsNullObject(requested) || CMIsNullObject(candidate)) return false;
  return samePath(requested, candidate) && (!flag || sameNamespace(requested, candidate));
}

}  // namespace QV
