#include "ModifyOperation.h"

#include <Trace.h>

#include "CmpiAccess.h"

namespace QV::IPConfigComposite {

CMPIStatus modifyInstance(const InstanceCall& call, Modify modify, const CMPIContext* ctx, const CMPIResult* rslt,
                          const CMPIObjectPath* cop, const CMPIInstance* ci, const char** properties) {
  const Frame frame(call.unit.component, call.unit.file, call.function);
  frame.markEntry();
  CMPIStatus status = {CMPI_RC_OK, nullptr};

  if (CMIsNullObject(ci)) {
    constexpr const char* noInstance = "Modify instance Passed is NULL";
    const CMPIString* const message = call.broker != nullptr ? CMNewString(call.broker, noInstance, nullptr) : nullptr;
    // The text goes to the log only: the client gets the bare code.
    frame.progress(message != nullptr ? textOf(message, nullptr) : noInstance, 353);
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
