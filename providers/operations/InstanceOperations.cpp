// SPDX-License-Identifier: Apache-2.0
// The source lines in the trace are fixed (compatibility 3).
#include "providers/operations/InstanceOperations.h"

#include <QV/ProviderHelper.h>

#include "factory/CmpiAccess.h"
#include "trace/Trace.h"

namespace QV::IPConfigComposite {

namespace {

// Reads every instance of the unit's class; false if the factory failed.
bool readAll(const InstanceCall& call, const CMPIContext* ctx, const CMPIObjectPath* op, const char** properties,
             std::vector<CMPIInstance*>& instances, CMPIStatus* status) {
  IPConfigObjectFactory factory;
  const char* className = classNameOf(op, status);
  return (factory.*call.unit.serves.getAll)(call.broker, ctx, op, className, properties, false, instances, status) == 0;
}

Frame frameOf(const InstanceCall& call) { return Frame(call.unit.component, call.unit.file, call.function); }

}  // namespace

CMPIStatus getInstance(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                       const CMPIObjectPath* op, const char** properties) {
  const Frame frame = frameOf(call);
  frame.markEntry(207);
  CMPIStatus status = {CMPI_RC_OK, nullptr};

  if (CMGetKeyCount(op, &status) == 0) {
    constexpr const char* keyless = "At least one key should be passed";
    CMSetStatus(&status, CMPI_RC_ERR_FAILED);
    if (call.broker) {
      status.msg = CMNewString(call.broker, keyless, nullptr);
    }
    traceToBroker(call.broker, CMPI_LEV_INFO, keyless);
    CMReturnDone(rslt);
    frame.markExit(265);
    return status;
  }

  std::vector<CMPIInstance*> instances;
  // compatibility 12: a failing factory ends the operation without returnDone and without the exit marker.
  if (!readAll(call, ctx, op, properties, instances, &status)) {
    return status;
  }
  for (std::uint16_t i = 0; i < countOf(instances); ++i) {
    const CMPIInstance* instance = instances.at(i);
    if (CMIsNullObject(instance)) {
      continue;
    }
    if (isObjPathsEqual(op, pathOf(instance, &status), false)) {
      CMReturnInstance(rslt, instance);
      break;
    }
  }
  CMReturnDone(rslt);
  frame.markExit(265);
  return status;
}

CMPIStatus enumInstances(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                         const CMPIObjectPath* op, const char** properties) {
  const Frame frame = frameOf(call);
  frame.markEntry(75);
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  std::vector<CMPIInstance*> instances;
  // compatibility 12: the one operation that marks its exit when the factory failed.
  if (!readAll(call, ctx, op, properties, instances, &status)) {
    frame.markExit(98);
    return status;
  }
  for (std::uint16_t i = 0; i < countOf(instances); ++i) {
    CMReturnInstance(rslt, instances.at(i));
  }
  CMReturnDone(rslt);
  frame.markExit(114);
  return status;
}

CMPIStatus enumInstanceNames(const InstanceCall& call, const CMPIContext* ctx, const CMPIResult* rslt,
                             const CMPIObjectPath* op) {
  const Frame frame = frameOf(call);
  frame.markEntry(137);
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  std::vector<CMPIInstance*> instances;
  // compatibility 12: a failing factory ends the operation without returnDone and without the exit marker.
  if (!readAll(call, ctx, op, nullptr, instances, &status)) {
    return status;
  }
  for (std::uint16_t i = 0; i < countOf(instances); ++i) {
    CMPIObjectPath* path = pathOf(instances.at(i), &status);
    if (CMIsNullObject(path)) {
      continue;
    }
    rehome(path, op, &status);
    CMReturnObjectPath(rslt, path);
  }
  CMReturnDone(rslt);
  frame.markExit(184);
  return status;
}

CMPIStatus modifyInstance(const InstanceCall& call, Modify modify, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* cop, const CMPIInstance* ci, const char** properties) {
  const Frame frame = frameOf(call);
  frame.markEntry();
  CMPIStatus status = {CMPI_RC_OK, nullptr};

  if (CMIsNullObject(ci)) {
    constexpr const char* noInstance = "Modify instance Passed is NULL";
    // compatibility 16: a message is made and dropped; the text goes to the log, the client gets the bare code.
    if (call.broker) {
      CMNewString(call.broker, noInstance, nullptr);
    }
    frame.progress(noInstance, 353);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_ERR_FAILED);
  }

  frame.variable("objstring", renderingOf(cop), 320);
  frame.variable("modifyobjstring", renderingOf(pathOf(ci, nullptr)), 330);
  IPConfigObjectFactory factory;
  if ((factory.*modify)(call.broker, ctx, cop, properties, false, ci, &status) != 0) {
    return status;
  }
  CMReturnDone(rslt);
  CMReturn(status.rc);
}

}  // namespace QV::IPConfigComposite
