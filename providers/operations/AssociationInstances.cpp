// SPDX-License-Identifier: Apache-2.0
// The instance side of an association class: what the unit's builder makes.
#include <QV/ProviderHelper.h>

#include "factory/CmpiAccess.h"
#include "providers/operations/AssociationOperations.h"
#include "trace/Trace.h"

namespace QV::IPConfigComposite {

namespace {

Frame frameOf(const AssociationCall& call) {
  return Frame(call.unit.trace.component, call.unit.trace.file, call.function);
}

CMPIStatus done(const CMPIResult* rslt, const Frame& frame, const CMPIStatus& status) {
  CMReturnDone(rslt);
  frame.markExit();
  return status;
}

}  // namespace

CMPIStatus getAssociation(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                          const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties) {
  const Frame frame = frameOf(call);
  frame.markEntry();
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  if (CMGetKeyCount(op, &status) == 0) {
    // compatibility 15: said in the log; to the client it is no error.
    frame.failure("At least one key should be passed");
    return done(rslt, frame, status);
  }
  std::vector<CMPIInstance*> instances;
  if (build(op, properties, ctx, instances) == 0) {
    for (std::uint16_t i = 0; i < countOf(instances); ++i) {
      const CMPIInstance* instance = instances.at(i);
      if (!CMIsNullObject(instance) && isObjPathsEqual(op, pathOf(instance, &status), true)) {
        CMReturnInstance(rslt, instance);
        break;
      }
    }
  }
  return done(rslt, frame, status);
}

CMPIStatus enumAssociations(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                            const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties) {
  const Frame frame = frameOf(call);
  frame.markEntry();
  const CMPIStatus status = {CMPI_RC_OK, nullptr};
  std::vector<CMPIInstance*> instances;
  if (build(op, properties, ctx, instances) == 0) {
    for (std::uint16_t i = 0; i < countOf(instances); ++i) {
      CMReturnInstance(rslt, instances.at(i));
    }
  }
  return done(rslt, frame, status);
}

CMPIStatus enumAssociationNames(const AssociationCall& call, BuildInstances build, const CMPIContext* ctx,
                                const CMPIResult* rslt, const CMPIObjectPath* op) {
  const Frame frame = frameOf(call);
  frame.markEntry();
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  std::vector<CMPIInstance*> instances;
  if (build(op, nullptr, ctx, instances) == 0) {
    for (std::uint16_t i = 0; i < countOf(instances); ++i) {
      const CMPIObjectPath* path = pathOf(instances.at(i), &status);
      if (!CMIsNullObject(path)) {
        CMReturnObjectPath(rslt, path);
      }
    }
  }
  return done(rslt, frame, status);
}

}  // namespace QV::IPConfigComposite
