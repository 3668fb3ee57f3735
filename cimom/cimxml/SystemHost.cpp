// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/SystemHost.h"

#include <cmpimacs.h>

#include <set>

#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

using Hosts = std::set<std::string, NameLess>;

std::string textOf(const CMPIString* string) {
  const char* text = string ? CMGetCharsPtr(string, nullptr) : nullptr;
  return text ? text : "";
}

// The hosts of a path and of the references among its keys, as far as they are in the namespace.
void collect(const CMPIObjectPath* path, const std::string& nameSpace, Hosts& hosts) {
  if (!path) {
    return;
  }
  const std::string host = textOf(CMGetHostname(path, nullptr));
  if (!host.empty() && sameName(bareNamespace(textOf(CMGetNameSpace(path, nullptr))), bareNamespace(nameSpace))) {
    hosts.insert(host);
  }
  const CMPICount count = CMGetKeyCount(path, nullptr);
  for (CMPICount i = 0; i < count; ++i) {
    const CMPIData key = CMGetKeyAt(path, i, nullptr, nullptr);
    if (key.type == CMPI_ref && !CMIsNullValue(key)) {
      collect(key.value.ref, nameSpace, hosts);
    }
  }
}

void collect(const CMPIInstance* instance, const std::string& nameSpace, Hosts& hosts) {
  collect(CMGetObjectPath(instance, nullptr), nameSpace, hosts);
  const CMPICount count = CMGetPropertyCount(instance, nullptr);
  for (CMPICount i = 0; i < count; ++i) {
    const CMPIData property = CMGetPropertyAt(instance, i, nullptr, nullptr);
    if (property.type == CMPI_ref && !CMIsNullValue(property)) {
      collect(property.value.ref, nameSpace, hosts);
    }
  }
}

}  // namespace

std::string systemHost(const std::vector<CMPIData>& objects, const std::string& nameSpace,
                       const std::string& otherwise) {
  Hosts hosts;
  for (const CMPIData& object : objects) {
    if (object.type == CMPI_instance) {
      collect(object.value.inst, nameSpace, hosts);
    } else if (object.type == CMPI_ref) {
      collect(object.value.ref, nameSpace, hosts);
    }
  }
  return hosts.size() == 1 ? *hosts.begin() : otherwise;
}

}  // namespace Cimom::CimXml
