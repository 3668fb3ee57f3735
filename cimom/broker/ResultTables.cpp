// SPDX-License-Identifier: Apache-2.0
// The function tables of what a provider answers with.
#include "cimom/broker/Guard.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

// CMPIResult.

void deliver(const CMPIResult* result, Value item) {
  Result& model = ownModelOf<Result>(result);
  if (item.isNull()) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "a result must not be null");
  }
  if (model.kind != CMPI_null && item.type() != model.kind) {
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "a result of this operation must be of type " +
                                                     describeType(model.kind) + ", not " + describeType(item.type()));
  }
  model.items.push_back(std::move(item));
}

// A result belongs to its operation, which alone reads it: a second one would deliver to nobody.
CMPIResult* cloneResult(const CMPIResult* result, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIResult*>(nullptr), [&]() -> CMPIResult* {
    modelOf<Result>(result);
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "a result cannot be cloned");
  });
}

CMPIStatus returnData(const CMPIResult* result, const CMPIValue* value, const CMPIType type) {
  return guarded([&] { deliver(result, fromCmpi(value, type)); });
}

CMPIStatus returnInstance(const CMPIResult* result, const CMPIInstance* instance) {
  return guarded([&] { deliver(result, Value::instance(argumentOf<Instance>(instance))); });
}

CMPIStatus returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path) {
  return guarded([&] { deliver(result, Value::reference(argumentOf<ObjectPath>(path))); });
}

// The end of the provider's call says the same, so that a call without it, or with two, loses nothing.
CMPIStatus returnDone(const CMPIResult* result) {
  return guarded([&] { modelOf<Result>(result); });
}

CMPIStatus returnError(const CMPIResult* result, const CMPIError* error) {
  return guarded([&] {
    Result& model = ownModelOf<Result>(result);
    const Error& returned = argumentOf<Error>(error);
    if (!model.error) {
      model.error = returned;
    }
  });
}

// CMPIError.

using OptionalText = std::optional<std::string> Error::*;
using OptionalArray = std::optional<Array> Error::*;

template <OptionalText member>
CMPIString* getText(const CMPIError* error, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIString*>(nullptr), [&] { return makeText(modelOf<Error>(error).*member); });
}

template <OptionalText member>
CMPIStatus setText(CMPIError* error, const char* text) {
  return guarded([&] { ownModelOf<Error>(error).*member = required(text, "the text"); });
}

template <OptionalArray member>
CMPIArray* getArray(const CMPIError* error, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIArray*>(nullptr), [&] {
    const auto& array = modelOf<Error>(error).*member;
    return array ? make(*array) : nullptr;
  });
}

template <OptionalArray member>
CMPIStatus setArray(CMPIError* error, const CMPIArray* array) {
  return guarded([&] {
    Error& model = ownModelOf<Error>(error);
    const Array& texts = *argumentOf<Array>(array);
    if (texts.elementType != CMPI_string) {
      throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "the array must hold strings");
    }
    model.*member = texts;
  });
}

CMPIStatus setMessageArguments(CMPIError* error, CMPIArray* array) {
  return setArray<&Error::messageArguments>(error, array);
}

template <typename Number, Number Error::*member>
Number getNumber(const CMPIError* error, CMPIStatus* status) {
  return guarded(status, Number{}, [&] { return modelOf<Error>(error).*member; });
}

template <typename Number, Number Error::*member>
CMPIStatus setNumber(CMPIError* error, const Number number) {
  return guarded([&] { ownModelOf<Error>(error).*member = number; });
}

}  // namespace

CMPIResultFT Abi<Result>::table = {CMPICurrentVersion, release<Result>,  cloneResult, returnData,
                                   returnInstance,     returnObjectPath, returnDone,  returnError};

CMPIErrorFT Abi<Error>::table = {
    .ftVersion = CMPICurrentVersion,
    .release = release<Error>,
    .clone = clone<Error>,
    .getErrorType = getNumber<CMPIErrorType, &Error::type>,
    .getOtherErrorType = getText<&Error::otherType>,
    .getOwningEntity = getText<&Error::owningEntity>,
    .getMessageID = getText<&Error::messageId>,
    .getMessage = getText<&Error::message>,
    .getPerceivedSeverity = getNumber<CMPIErrorSeverity, &Error::severity>,
    .getProbableCause = getNumber<CMPIErrorProbableCause, &Error::probableCause>,
    .getProbableCauseDescription = getText<&Error::probableCauseDescription>,
    .getRecommendedActions = getArray<&Error::recommendedActions>,
    .getErrorSource = getText<&Error::source>,
    .getErrorSourceFormat = getNumber<CMPIErrorSrcFormat, &Error::sourceFormat>,
    .getOtherErrorSourceFormat = getText<&Error::otherSourceFormat>,
    .getCIMStatusCode = getNumber<CMPIrc, &Error::statusCode>,
    .getCIMStatusCodeDescription = getText<&Error::statusCodeDescription>,
    .getMessageArguments = getArray<&Error::messageArguments>,
    .setErrorType = setNumber<CMPIErrorType, &Error::type>,
    .setOtherErrorType = setText<&Error::otherType>,
    .setProbableCauseDescription = setText<&Error::probableCauseDescription>,
    .setRecommendedActions = setArray<&Error::recommendedActions>,
    .setErrorSource = setText<&Error::source>,
    .setErrorSourceFormat = setNumber<CMPIErrorSrcFormat, &Error::sourceFormat>,
    .setOtherErrorSourceFormat = setText<&Error::otherSourceFormat>,
    .setCIMStatusCodeDescription = setText<&Error::statusCodeDescription>,
    .setMessageArguments = setMessageArguments,
};

}  // namespace Cimom
