// SPDX-License-Identifier: Apache-2.0
// Asks for the underlying endpoints, makes an instance of the composite class for each, copies the properties that the
// product copies, and returns it. It keeps no frame in a log, asks no helper, selects nothing and trusts the broker.
#include "bench/MinimalProvider.h"

#include <cmpimacs.h>

#include <cstring>

namespace {

const CMPIBroker* broker = nullptr;

constexpr const char* compositeClass = "YRNx_MgmtHwIPProtocolEndPoint";
constexpr const char* copied[] = {"Name",         "SystemName",    "NameFormat",       "ElementName",
                                  "IPv4Address",  "IPv6Address",   "SubnetMask",       "PrefixLength",
                                  "AddressType",  "AddressOrigin", "IPVersionSupport", "ProtocolIFType",
                                  "EnabledState", "RequestedState"};

CMPIInstance* compositeOf(const CMPIInstance* underlying, const char* nameSpace) {
  const CMPIObjectPath* path = CMNewObjectPath(broker, nameSpace, compositeClass, nullptr);
  CMPIInstance* composite = CMNewInstance(broker, path, nullptr);
  CMSetProperty(composite, "SystemCreationClassName", "YRNx_MgmtHwComputerSystem", CMPI_chars);
  CMSetProperty(composite, "CreationClassName", compositeClass, CMPI_chars);
  for (const char* name : copied) {
    const CMPIData data = CMGetProperty(underlying, name, nullptr);
    if (!CMIsNullValue(data)) {
      CMSetProperty(composite, name, &data.value, data.type);
    }
  }
  return composite;
}

// Hands every composite to `visit` until it wants no more.
template <typename Visit>
CMPIStatus forEachComposite(const CMPIContext* ctx, const CMPIResult* rslt, const CMPIObjectPath* op, Visit visit) {
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  const char* nameSpace = CMGetCharsPtr(CMGetNameSpace(op, nullptr), nullptr);
  const CMPIObjectPath* path = CMNewObjectPath(broker, "root/yrnse", "YRNQV_IPProtocolEndpoint", nullptr);
  const CMPIEnumeration* underlyings = CBEnumInstances(broker, ctx, path, nullptr, &status);
  while (status.rc == CMPI_RC_OK && CMHasNext(underlyings, nullptr)) {
    if (!visit(compositeOf(CMGetNext(underlyings, nullptr).value.inst, nameSpace))) {
      break;
    }
  }
  CMReturnDone(rslt);
  return status;
}

CMPIStatus MinimalEnumInstances(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,
                                const CMPIObjectPath* op, const char**) {
  return forEachComposite(ctx, rslt, op, [&](const CMPIInstance* composite) {
    CMReturnInstance(rslt, composite);
    return true;
  });
}

CMPIStatus MinimalEnumInstanceNames(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,
                                    const CMPIObjectPath* op) {
  return forEachComposite(ctx, rslt, op, [&](const CMPIInstance* composite) {
    CMReturnObjectPath(rslt, CMGetObjectPath(composite, nullptr));
    return true;
  });
}

// "Name" alone tells endpoints apart.
CMPIStatus MinimalGetInstance(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt, const CMPIObjectPath* op,
                              const char**) {
  const auto nameOf = [](const CMPIData& data) { return CMGetCharsPtr(data.value.string, nullptr); };
  const char* wanted = nameOf(CMGetKey(op, "Name", nullptr));
  return forEachComposite(ctx, rslt, op, [&](const CMPIInstance* composite) {
    if (std::strcmp(nameOf(CMGetProperty(composite, "Name", nullptr)), wanted) != 0) {
      return true;
    }
    CMReturnInstance(rslt, composite);
    return false;
  });
}

CMPIStatus MinimalCleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { CMReturn(CMPI_RC_OK); }

CMPIStatus MinimalCreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                 const CMPIInstance*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus MinimalModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                 const CMPIInstance*, const char**) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus MinimalDeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus MinimalExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*,
                            const char*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

}  // namespace

CMInstanceMIStub(Minimal, MinimalProvider, broker, CMNoHook)
