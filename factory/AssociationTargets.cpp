// SPDX-License-Identifier: Apache-2.0
// Which class lies at the far end of an association, seen from either end.
#include <QV/ProviderHelper.h>

#include "factory/CmpiAccess.h"
#include "factory/FactoryFrame.h"
#include "factory/Model.h"

namespace QV::IPConfigComposite {

namespace {

// Null for a pair that the model does not have.
const CompositeClass* farEndOf(const char* sourceClass, const char* associationClass) {
  for (const View& view : views) {
    if (textEqual(sourceClass, view.sourceClass().name) && textEqual(associationClass, view.association.name)) {
      return &view.farClass();
    }
  }
  return nullptr;
}

}  // namespace

const char* IPConfigObjectFactory::get_assoc_targetClass_Name(const CMPIBroker*, const CMPIObjectPath* sourcePath,
                                                              const char* assocClass, const char*, CMPIStatus* status) {
  const Frame frame = factoryFrame(__func__);
  frame.entering();
  const char* sourceClass = classNameOf(sourcePath, status);
  if (const CompositeClass* target = farEndOf(sourceClass, assocClass)) {
    frame.progress(target->name);
    return target->name;
  }
  frame.progress("Target Assoc Class Not Found");
  frame.variable("sourceclass", sourceClass);
  return "";
}

CMPIObjectPath* IPConfigObjectFactory::get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
                                                                        const CMPIObjectPath* sourcePath,
                                                                        const char* assocClass, const char* resultClass,
                                                                        CMPIStatus* status) {
  const Frame frame = factoryFrame(__func__);
  frame.entering();
  const char* targetName = get_assoc_targetClass_Name(broker, sourcePath, assocClass, resultClass, status);
  frame.variable("targetName", targetName);
  if (textEqual(targetName, "")) {
    return nullptr;
  }
  frame.progress(" Creating CMNewObjectPath");
  CMPIObjectPath* path = CMNewObjectPath(broker, nameSpaceOf(sourcePath, status), targetName, status);
  rehome(path, sourcePath, status);
  return path;
}

}  // namespace QV::IPConfigComposite
