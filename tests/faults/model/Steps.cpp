// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/model/Steps.h"

#include <QV/ProviderHelper.h>
#include <cmpimacs.h>

#include "tests/faults/model/Access.h"

namespace Testing::Model {

namespace {

void setText(CMPIInstance* instance, const Constant& property) {
  if (usable(instance)) {
    CMSetProperty(instance, property.name, property.value, CMPI_chars);
  }
}

bool isChosen(const Composite& composite, const CMPIInstance* underlying, CMPIStatus* status) {
  switch (composite.chosen) {
    case Chosen::All:
      return true;
    case Chosen::OfProcessor:
      return textProperty(underlying, "SystemCreationClassName", status, status) == "YRNQV_SPComputerSystem";
    case Chosen::ByIdentifier: {
      const auto fields = fieldsOf(textProperty(underlying, "InstanceID", status, status));
      return fields.size() == composite.identifierFields && QV::textEqual(fields[0].c_str(), "BMC");
    }
  }
  return false;
}

// An item of another type carries no instance, whatever it points to.
CMPIData instanceIn(const CMPIData& data) {
  CMPIData item = {CMPI_instance, CMPI_nullValue, {}};
  if (data.type == CMPI_instance && usable(data.value.inst)) {
    item.state = CMPI_goodValue;
    item.value.inst = data.value.inst;
  }
  return item;
}

}  // namespace

Steps::Steps(const Request& request)
    : request_(request), operation_{request.component, request.file, request.prefix + nameOf(request.operation)} {}

void Steps::traceToBroker(int level, const char* text) const {
  CMTraceMessage(request_.broker, level, "CompositeIPConfigProvider", text, nullptr);
}

void Steps::rehome(CMPIObjectPath* path, CMPIStatus* status) const {
  if (usable(path)) {
    const std::string nameSpace = nameSpaceOf(request_.path, status);
    CMSetNameSpace(path, nameSpace.c_str());
    CMSetHostname(path, QV::getSystemName().c_str());
  }
}

void Steps::setReference(CMPIInstance* instance, const char* name, const CMPIObjectPath* path) {
  if (usable(instance) && usable(path)) {
    CMSetProperty(instance, name, &path, CMPI_ref);
  }
}

CMPIInstance* Steps::make(const Composite& composite, const char** properties, CMPIStatus* status) const {
  const Report report = memberReport(composite.make);
  report.entering();
  report.message("Calling CMNewObjectPath");
  const std::string first = nameSpaceOf(request_.path, status);
  CMPIObjectPath* path = CMNewObjectPath(request_.broker, first.c_str(), composite.name, nullptr);
  if (!usable(path)) {
    report.exiting();
    return nullptr;
  }
  report.message("Calling CMSetNameSpace");
  const std::string nameSpace = nameSpaceOf(request_.path, status);
  report.variable("namesp", nameSpace);
  report.variable("systemname", QV::getSystemName());
  CMSetNameSpace(path, nameSpace.c_str());
  report.message("Calling CMSetHostname");
  CMSetHostname(path, QV::getSystemName().c_str());
  report.message("Calling CMNewInstance");
  CMPIInstance* instance = CMNewInstance(request_.broker, path, nullptr);
  if (usable(instance)) {
    std::vector<const char*> keys = composite.keys;
    CMSetPropertyFilter(instance, properties, keys.data());
    for (const Constant& constant : composite.constants) {
      setText(instance, constant);
    }
  }
  report.exiting();
  return instance;
}

// What the computer system has besides copies; false if the array that probes for memory cannot be made.
bool Steps::addSystemProperties(const Report& report, const CMPIInstance* underlying, CMPIInstance* composite,
                                CMPIUint16 index, CMPIStatus* status) const {
  if (!CMNewArray(request_.broker, 4, CMPI_uint16, status)) {
    const char* text = "Create Array for Property Dedicated failed.";
    status->rc = CMPI_RC_ERR_FAILED;
    status->msg = CMNewString(request_.broker, text, nullptr);
    traceToBroker(2, text);
    return false;
  }
  report.message(" CMGetProperty Dedicated");
  if (usable(underlying)) {
    const CMPIData dedicated = CMGetProperty(underlying, "Dedicated", status);
    if (!flaggedNull(dedicated) && CMIsArray(dedicated) && usable(dedicated.value.array)) {
      CMGetArrayCount(dedicated.value.array, status);
      report.message(" CMSetProperty Dedicated");
      if (usable(composite)) {
        CMSetProperty(composite, "Dedicated", &dedicated.value.array, CMPI_uint16A);
      }
    }
  }
  report.message(" CMSetProperty Index");
  if (usable(composite)) {
    CMSetProperty(composite, "Index", &index, CMPI_uint16);
  }
  return true;
}

bool Steps::getAll(const std::string& className, const Composite& composite, const char** properties, Instances& out,
                   CMPIStatus* status) const {
  const Report report = memberReport(composite.getAll);
  report.entering();
  if (!QV::textEqual(className.c_str(), composite.name)) {
    traceToBroker(2, "***No instance found***");
    return false;
  }
  const bool isSystem = composite.chosen == Chosen::All;
  CMPIObjectPath* path = CMNewObjectPath(request_.broker, "root/yrnse", composite.underlying, status);
  CMPIEnumeration* enumeration = CBEnumInstances(request_.broker, request_.context, path, nullptr, status);
  if (status->rc == CMPI_RC_OK && usable(enumeration)) {
    CMPIUint16 index = 0;
    while (CMHasNext(enumeration, status)) {
      const CMPIData item = instanceIn(CMGetNext(enumeration, status));
      if (!isChosen(composite, item.value.inst, status)) {
        continue;
      }
      CMPIInstance* instance = make(composite, properties, status);
      for (const Property& property : composite.copied) {
        QV::mapProperty(item, instance, property.name, property.type, status);
      }
      if (composite.last) {
        setText(instance, *composite.last);
      }
      if (isSystem && !addSystemProperties(report, item.value.inst, instance, ++index, status)) {
        return false;
      }
      out.push_back(instance);
      if (isSystem) {
        report.message(" Insatance done");
        traceToBroker(1, "***Returning One IPConfig instance***");
      }
    }
  }
  if (composite.identifierFields == 3) {
    report.operationExit();
  } else {
    report.exiting();
  }
  return true;
}

void Steps::returnMatching(const Instances& instances, bool flag) {
  for (CMPIInstance* instance : instances) {
    if (!usable(instance)) {
      continue;
    }
    if (QV::isObjPathsEqual(request_.path, CMGetObjectPath(instance, &status_), flag)) {
      CMReturnInstance(request_.result, instance);
      return;
    }
  }
}

void Steps::returnRehomedPath(CMPIObjectPath* path) {
  if (usable(path)) {
    rehome(path, &status_);
    CMReturnObjectPath(request_.result, path);
  }
}

}  // namespace Testing::Model
