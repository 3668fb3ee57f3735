// A provider as a site would write one: two instances of whatever class it is asked for, and nothing else.
#include <cmpimacs.h>

#include <initializer_list>

namespace {

const CMPIBroker* broker = nullptr;

CMPIInstance* makeSystem(const CMPIObjectPath* asked, const char* name) {
  const char* nameSpace = CMGetCharsPtr(asked->ft->getNameSpace(asked, nullptr), nullptr);
  const char* className = CMGetCharsPtr(asked->ft->getClassName(asked, nullptr), nullptr);
  CMPIObjectPath* path = CMNewObjectPath(broker, nameSpace, className, nullptr);
  CMAddKey(path, "CreationClassName", className, CMPI_chars);
  CMAddKey(path, "Name", name, CMPI_chars);
  return CMNewInstance(broker, path, nullptr);
}

CMPIStatus ProbeCleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { CMReturn(CMPI_RC_OK); }

CMPIStatus ProbeEnumInstanceNames(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                  const CMPIObjectPath* asked) {
  for (const char* name : {"one", "two"}) {
    const CMPIInstance* system = makeSystem(asked, name);
    CMReturnObjectPath(result, system->ft->getObjectPath(system, nullptr));
  }
  CMReturnDone(result);
  CMReturn(CMPI_RC_OK);
}

CMPIStatus ProbeEnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                              const CMPIObjectPath* asked, const char**) {
  for (const char* name : {"one", "two"}) {
    CMReturnInstance(result, makeSystem(asked, name));
  }
  CMReturnDone(result);
  CMReturn(CMPI_RC_OK);
}

CMPIStatus ProbeGetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                            const char**) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus ProbeCreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const CMPIInstance*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus ProbeModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const CMPIInstance*, const char**) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus ProbeDeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus ProbeExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*,
                          const char*) {
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

}  // namespace

CMInstanceMIStub(Probe, ProbeSystem, broker, CMNoHook)
