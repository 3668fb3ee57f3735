#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

using OptionalText = std::optional<std::string> Error::*;
using OptionalArray = std::optional<Array> Error::*;

template <OptionalText member>
CMPIString* getText(const CMPIError* error, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIString*>(nullptr), [&] { return makeText(modelOf<Error>(error).*member); });
}

template <OptionalText member>
CMPIStatus setText(CMPIError* error, const char* text) {
  return guarded([&] { modelOf<Error>(error).*member = required(text, "the text"); });
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
    Error& model = modelOf<Error>(error);
    model.*member = modelOf<Array>(array);
  });
}

CMPIStatus setMessageArguments(CMPIError* error, CMPIArray* array) {
  return setArray<&Error::messageArguments>(error, array);
}

template <class Number, Number Error::*member>
Number getNumber(const CMPIError* error, CMPIStatus* status) {
  return guarded(status, Number{}, [&] { return modelOf<Error>(error).*member; });
}

template <class Number, Number Error::*member>
CMPIStatus setNumber(CMPIError* error, const Number number) {
  return guarded([&] { modelOf<Error>(error).*member = number; });
}

}  // namespace

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
