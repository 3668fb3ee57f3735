// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Recording.h"

#include <cmpimacs.h>

#include "cimom/broker/Handle.h"

namespace Testing {

namespace {

using Cimom::Instance;
using Cimom::ObjectPath;
using Cimom::Value;

std::string shown(const Value& value) {
  if (const Cimom::Array* array = value.elements()) {
    std::string text = "{";
    for (const Value& element : array->elements) {
      text += ' ' + element.toString();
    }
    return text + " }";
  }
  return value.isNull() ? "null" : std::to_string(value.type()) + ':' + value.toString();
}

std::string shown(const CMPIInstance* instance) {
  if (!instance || !instance->hdl) {
    return instance ? "instance without handle" : "null instance";
  }
  const auto& model = Cimom::modelOf<Instance>(instance);
  std::string text = "instance " + model.path().toString();
  for (std::size_t i = 0; i < model.size(); ++i) {
    if (!model[i].isNull()) {
      text += "; " + model.definition().properties[i].name + '=' + shown(model[i]);
    }
  }
  const auto filter = recording().filters.find(instance);
  return text + "; filter " + (filter == recording().filters.end() ? "none" : filter->second);
}

CMPIStatus returnInstance(const CMPIResult*, const CMPIInstance* instance) {
  recording().outcome->answered.push_back(shown(instance));
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnObjectPath(const CMPIResult*, const CMPIObjectPath* path) {
  recording().outcome->answered.push_back(textOf(path));
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnDone(const CMPIResult*) {
  recording().outcome->answered.push_back("done");
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnData(const CMPIResult*, const CMPIValue*, const CMPIType) {
  recording().outcome->answered.push_back("data");
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnError(const CMPIResult*, const CMPIError*) {
  recording().outcome->answered.push_back("error");
  return {CMPI_RC_OK, nullptr};
}

std::string listed(const char** names) {
  std::string text = names ? "(" : "null";
  for (; names && *names; ++names) {
    text += std::string(*names) + ' ';
  }
  return text;
}

CMPIResultFT resultTable = {CMPICurrentVersion, nullptr,          nullptr,    returnData,
                            returnInstance,     returnObjectPath, returnDone, returnError};

}  // namespace

Recording& recording() {
  static Recording underWay;
  return underWay;
}

CMPIResult* recordingResult() {
  static CMPIResult result = {&resultTable, &resultTable};
  return &result;
}

std::string textOf(const CMPIObjectPath* path) {
  if (!path || !path->hdl) {
    return path ? "path without handle" : "null path";
  }
  return "path " + Cimom::modelOf<ObjectPath>(path).toString();
}

void recordFilter(const CMPIInstance* instance, const char** properties, const char** keys) {
  recording().filters[instance] = listed(properties) + " keys " + listed(keys);
}

}  // namespace Testing
