// SPDX-License-Identifier: Apache-2.0
#include "cimom/routing/SameObject.h"

#include <algorithm>

#include "cimom/model/Names.h"

namespace Cimom {
namespace {

std::string shown(const Value& value) { return value.text() ? *value.text() : value.toString(); }

}  // namespace

bool sameKey(const Value& one, const Value& other, std::string_view nameSpace) {
  if (one.isNull() || other.isNull()) {
    return one.isNull() && other.isNull();
  }
  if (one.path() && other.path()) {
    return sameObject(*one.path(), *other.path(), nameSpace);
  }
  if (one.time() && other.time()) {
    return one.time()->microseconds == other.time()->microseconds && one.time()->interval == other.time()->interval;
  }
  return shown(one) == shown(other);
}

bool sameObject(const ObjectPath& one, const ObjectPath& other, std::string_view nameSpace) {
  const auto place = [&](const ObjectPath& path) {
    return bareNamespace(path.nameSpace.empty() ? nameSpace : std::string_view(path.nameSpace));
  };
  return sameName(one.className, other.className) && sameName(place(one), place(other)) &&
         one.keys.size() == other.keys.size() && std::ranges::all_of(one.keys, [&](const NamedValues::Entry& key) {
           const Value* counterpart = other.keys.find(key.name);
           return counterpart && sameKey(key.value, *counterpart, nameSpace);
         });
}

}  // namespace Cimom
