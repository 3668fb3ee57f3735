// SPDX-License-Identifier: Apache-2.0
#include "factory/CompositeInstances.h"

#include <string_view>

#include "factory/CmpiAccess.h"
#include "factory/FactoryFrame.h"

namespace QV::IPConfigComposite {

namespace {

constexpr const char* underlyingNameSpace = "root/yrnse";
constexpr const char* processorClass = "YRNQV_SPComputerSystem";

bool identifierHasForm(const std::string& identifier, std::size_t fields) {
  std::vector<std::string> tokens;
  IPConfigObjectFactory().Tokenize(identifier, tokens, ":");
  return tokens.size() == fields && textEqual(tokens[0].c_str(), bmcComputername);
}

bool isSelected(const CompositeClass& row, const CMPIInstance* underlying, CMPIStatus* status) {
  switch (row.selection) {
    case Selection::Every:
      return true;
    case Selection::OwnedByProcessor:
      return textOf(propertyOf(underlying, "SystemCreationClassName", status), status) ==
             std::string_view(processorClass);
    case Selection::IdentifierOfFields:
      return identifierHasForm(textOf(propertyOf(underlying, "InstanceID", status), status), row.identifierFields);
  }
  return false;
}

// Whether memory for an array can be had (compatibility 17). The array is dropped: it only decides whether the system
// is built at all, so that a broker out of memory ends the request with a status.
bool probeForArray(const Request& request) {
  constexpr CMPICount probeSize = 4;
  if (CMNewArray(request.broker, probeSize, CMPI_uint16, request.status)) {
    return true;
  }
  constexpr const char* failed = "Create Array for Property Dedicated failed.";
  CMSetStatusWithChars(request.broker, request.status, CMPI_RC_ERR_FAILED, failed);
  traceToBroker(request.broker, CMPI_LEV_WARNING, failed);
  return false;
}

void copyDedicated(const Frame& frame, const CMPIInstance* underlying, CMPIInstance* composite, CMPIStatus* status) {
  frame.progress(" CMGetProperty Dedicated");
  const CMPIData dedicated = propertyOf(underlying, "Dedicated", status);
  if (CMIsNullValue(dedicated) || !CMIsArray(dedicated) || CMIsNullObject(dedicated.value.array)) {
    return;
  }
  CMGetArrayCount(dedicated.value.array, status);
  frame.progress(" CMSetProperty Dedicated");
  if (!CMIsNullObject(composite)) {
    CMSetProperty(composite, "Dedicated", &dedicated.value.array, CMPI_uint16A);
  }
}

void setIndex(const Frame& frame, CMPIInstance* composite, CMPIUint16 index) {
  frame.progress(" CMSetProperty Index");
  if (!CMIsNullObject(composite)) {
    CMSetProperty(composite, "Index", &index, CMPI_uint16);
  }
}

void end(const CompositeClass& row, const Frame& frame) {
  if (row.ending == Ending::ExitMarker) {
    frame.markExit();
  } else {
    frame.exiting();
  }
}

}  // namespace

int readComposites(const CompositeClass& row, const char* function, const Request& request, const CMPIContext* ctx,
                   const char* className, std::vector<CMPIInstance*>& out) {
  const Frame frame = factoryFrame(function);
  frame.entering();
  const CMPIBroker* broker = request.broker;
  CMPIStatus* status = request.status;
  if (!textEqual(className, row.name)) {
    traceToBroker(broker, CMPI_LEV_WARNING, "***No instance found***");
    return 1;
  }

  const CMPIObjectPath* path = CMNewObjectPath(broker, underlyingNameSpace, row.underlying, status);
  // Asked also without a path: the broker's answer to that is the client's.
  const CMPIEnumeration* underlyings = CBEnumInstances(broker, ctx, path, nullptr, status);
  if (status->rc != CMPI_RC_OK || CMIsNullObject(underlyings)) {
    end(row, frame);
    return 0;
  }

  CMPIUint16 index = 0;
  while (CMHasNext(underlyings, status)) {
    const CMPIData item = instanceItem(CMGetNext(underlyings, status));
    const CMPIInstance* underlying = item.value.inst;
    if (!isSelected(row, underlying, status)) {
      continue;
    }
    CMPIInstance* composite =
        (IPConfigObjectFactory().*row.make)(broker, request.ref, request.properties, request.noFilter, status);
    for (const MappedProperty& property : row.mapped) {
      mapProperty(item, composite, property.name, property.type, status);
    }
    for (const TextProperty& property : row.finals) {
      setText(composite, property.name, property.value);
    }
    if (row.extra == Extra::NumberedSystem) {
      if (!probeForArray(request)) {
        return 1;
      }
      copyDedicated(frame, underlying, composite, status);
      setIndex(frame, composite, ++index);
    }
    out.push_back(composite);
    if (row.extra == Extra::NumberedSystem) {
      frame.progress(" Insatance done");  // compatibility 2
      traceToBroker(broker, CMPI_LEV_INFO, "***Returning One IPConfig instance***");
    }
  }
  end(row, frame);
  return 0;
}

CMPIInstance* makeComposite(const CompositeClass& row, const char* function, const Request& request) {
  const Frame frame = factoryFrame(function);
  frame.entering();
  const CMPIBroker* broker = request.broker;
  frame.progress("Calling CMNewObjectPath");
  CMPIObjectPath* path = CMNewObjectPath(broker, nameSpaceOf(request.ref, request.status), row.name, nullptr);
  if (CMIsNullObject(path)) {
    frame.exiting();
    return nullptr;
  }

  frame.progress("Calling CMSetNameSpace");
  const char* nameSpace = nameSpaceOf(request.ref, request.status);
  frame.variable("namesp", nameSpace);
  frame.variable("systemname", getSystemName().c_str());
  CMSetNameSpace(path, nameSpace);
  frame.progress("Calling CMSetHostname");
  CMSetHostname(path, getSystemName().c_str());

  frame.progress("Calling CMNewInstance");
  CMPIInstance* instance = CMNewInstance(broker, path, nullptr);
  if (!CMIsNullObject(instance)) {
    if (!request.noFilter) {
      CMSetPropertyFilter(instance, request.properties, row.keys.data());
    }
    for (const TextProperty& property : row.constants) {
      setText(instance, property.name, property.value);
    }
  }
  frame.exiting();
  return instance;
}

}  // namespace QV::IPConfigComposite
