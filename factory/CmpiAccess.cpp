// SPDX-License-Identifier: Apache-2.0
#include "factory/CmpiAccess.h"

#include <QV/ProviderHelper.h>

namespace QV::IPConfigComposite {

namespace {

const char* orEmpty(const char* text) { return text ? text : ""; }

constexpr CMPIData nothing = {CMPI_null, CMPI_nullValue, {}};

}  // namespace

const char* textOf(const CMPIString* string, CMPIStatus* status) {
  return CMIsNullObject(string) ? "" : orEmpty(CMGetCharsPtr(string, status));
}

const char* textOf(const CMPIData& data, CMPIStatus* status) {
  if (CMIsNullValue(data)) {
    return "";
  }
  switch (data.type) {
    case CMPI_string:
      return textOf(data.value.string, status);
    case CMPI_chars:
      return orEmpty(data.value.chars);
    default:
      return "";
  }
}

const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status) {
  return CMIsNullObject(path) ? "" : textOf(CMGetNameSpace(path, status), status);
}

const char* classNameOf(const CMPIObjectPath* path, CMPIStatus* status) {
  return CMIsNullObject(path) ? "" : textOf(CMGetClassName(path, status), status);
}

const char* renderingOf(const CMPIObjectPath* path) {
  return CMIsNullObject(path) ? "" : textOf(CMObjectPathToString(path, nullptr), nullptr);
}

CMPIData keyOf(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  return CMIsNullObject(path) ? nothing : CMGetKey(path, name, status);
}

CMPIData propertyOf(const CMPIInstance* instance, const char* name, CMPIStatus* status) {
  return CMIsNullObject(instance) ? nothing : CMGetProperty(instance, name, status);
}

CMPIData instanceItem(const CMPIData& item) {
  CMPIData instance = {CMPI_instance, CMPI_nullValue, {}};
  if (item.type == CMPI_instance && !CMIsNullObject(item.value.inst)) {
    instance.state = CMPI_goodValue;
    instance.value.inst = item.value.inst;
  }
  return instance;
}

CMPIObjectPath* pathOf(const CMPIInstance* instance, CMPIStatus* status) {
  return CMIsNullObject(instance) ? nullptr : CMGetObjectPath(instance, status);
}

void setText(CMPIInstance* instance, const char* name, const char* text) {
  if (!CMIsNullObject(instance)) {
    CMSetProperty(instance, name, text, CMPI_chars);
  }
}

void setReference(CMPIInstance* instance, const char* name, const CMPIObjectPath* path) {
  if (!CMIsNullObject(instance) && !CMIsNullObject(path)) {
    CMSetProperty(instance, name, &path, CMPI_ref);
  }
}

void rehome(CMPIObjectPath* path, const CMPIObjectPath* request, CMPIStatus* status) {
  if (!CMIsNullObject(path)) {
    CMSetNameSpace(path, nameSpaceOf(request, status));
    CMSetHostname(path, getSystemName().c_str());
  }
}

void traceToBroker(const CMPIBroker* broker, int level, const char* text) {
  if (broker) {
    CMTraceMessage(broker, static_cast<Cmpi::TraceLevel>(level), "CompositeIPConfigProvider", text, nullptr);
  }
}

std::uint16_t countOf(const std::vector<CMPIInstance*>& instances) {
  return static_cast<std::uint16_t>(instances.size());
}

}  // namespace QV::IPConfigComposite
