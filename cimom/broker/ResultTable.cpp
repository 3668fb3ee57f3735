#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

void deliver(const CMPIResult* result, Value item) {
  Result& model = modelOf<Result>(result);
  if (item.isNull()) throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "null returned as a result");
  if (model.kind != CMPI_null && item.type() != model.kind) {
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED,
                      "the operation takes no " + typeName(item.type()) + ", but " + typeName(model.kind) + "s");
  }
  model.items.push_back(std::move(item));
}

/// A result belongs to its operation, which alone reads it: a second one would deliver to nobody.
CMPIResult* cloneResult(const CMPIResult* result, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIResult*>(nullptr), [&]() -> CMPIResult* {
    modelOf<Result>(result);
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "a result cannot be cloned");
  });
}

CMPIStatus returnData(const CMPIResult* result, const CMPIValue* value, const CMPIType type) {
  return guarded([&] { deliver(result, Value::fromCmpi(value, type)); });
}

CMPIStatus returnInstance(const CMPIResult* result, const CMPIInstance* instance) {
  return guarded([&] { deliver(result, Value::instance(modelOf<Instance>(instance))); });
}

CMPIStatus returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path) {
  return guarded([&] { deliver(result, Value::reference(modelOf<ObjectPath>(path))); });
}

/// The end of the provider's call says the same, so that a call without it, or with two, loses nothing.
CMPIStatus returnDone(const CMPIResult* result) {
  return guarded([&] { modelOf<Result>(result); });
}

CMPIStatus returnError(const CMPIResult* result, const CMPIError* error) {
  return guarded([&] {
    Result& model = modelOf<Result>(result);
    const Error& returned = modelOf<Error>(error);
    if (!model.error) model.error = returned;
  });
}

}  // namespace

CMPIResultFT Abi<Result>::table = {CMPICurrentVersion, release<Result>,  cloneResult, returnData,
                                   returnInstance,     returnObjectPath, returnDone,  returnError};

}  // namespace Cimom
