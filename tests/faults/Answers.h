// SPDX-License-Identifier: Apache-2.0
// What an interposed slot answers: what the object manager does, unless the call fails.
#pragma once

#include <cmpimacs.h>

#include <type_traits>

#include "tests/faults/Calls.h"
#include "tests/faults/Interposed.h"

namespace Testing {

using Call = Calls::Call;

inline constexpr CMPIrc injected = CMPI_RC_ERR_ACCESS_DENIED;  // a code that the library does not set itself

// The tables as the object manager has them, and those that stand in front.
template <typename Table>
inline Table original = {};
template <typename Table>
inline Table interposed = {};

inline void setCode(CMPIStatus* status, CMPIrc code) {
  if (status) {
    *status = {code, nullptr};
  }
}

template <typename Object>
using TableOf = std::remove_pointer_t<decltype(Object::ft)>;

template <typename Object>
Object* adopted(Object* object, const Call& call) {
  if (object) {
    interpose(object);
    calls().adopt(object, call);
  }
  return object;
}

template <typename Object>
Object* objectWithoutHandle() {
  static Object object = {nullptr, &interposed<TableOf<Object>>};
  return &object;
}

// Makes the object that a value holds known.
void adoptValue(const CMPIData& data, const Call& call);
// Which faults a value can have that the call really answered, and the value with the one that the call has.
Faults faultsOf(const CMPIData& data, bool tellsStatus);
CMPIData spoiled(CMPIData data, CMPIStatus* status, const Call& call);

// What a slot answers, by its type: the call is made unless the fault is that it is not.
template <typename Made>
CMPIData answer(const Call& call, CMPIStatus* status, Made make, const CMPIData*) {
  const CMPIData data = make();
  adoptValue(data, call);
  call.noteAndThrow(faultsOf(data, status));
  return spoiled(data, status, call);
}

template <typename Object, typename Made>
Object* answer(const Call& call, CMPIStatus* status, Made make, Object* const*) {
  Faults faults = {Fault::NullWithError, Fault::WithoutHandle};
  if (status) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  call.noteAndThrow(faults);
  switch (call.fault) {
    case Fault::NullWithError:
      setCode(status, injected);
      return nullptr;
    case Fault::NullSilently:
      setCode(status, CMPI_RC_OK);
      return nullptr;
    case Fault::WithoutHandle:
      setCode(status, CMPI_RC_OK);
      return objectWithoutHandle<Object>();
    default:
      break;
  }
  Object* object = adopted(make(), call);
  if (call.fault == Fault::GoodWithError) {
    setCode(status, injected);
  }
  return object;
}

template <typename Made>
const char* answer(const Call& call, CMPIStatus* status, Made make, const char* const*) {
  Faults faults = {Fault::NullWithError};
  if (status) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  call.noteAndThrow(faults);
  const char* characters = make();
  if (call.fault == Fault::NullWithError || call.fault == Fault::GoodWithError) {
    setCode(status, injected);
  }
  return call.fault == Fault::NullWithError || call.fault == Fault::NullSilently ? nullptr : characters;
}

template <typename Made>
CMPIStatus answer(const Call& call, CMPIStatus*, Made make, const CMPIStatus*) {
  call.noteAndThrow({Fault::FailsUndone, Fault::FailsDone, Fault::UndoneSilently});
  const bool done = call.fault != Fault::FailsUndone && call.fault != Fault::UndoneSilently;
  const CMPIStatus status = done ? make() : CMPIStatus{CMPI_RC_OK, nullptr};
  return call.fault == Fault::FailsUndone || call.fault == Fault::FailsDone ? CMPIStatus{injected, nullptr} : status;
}

// Numbers and yes or no: a null is 0.
template <typename Number, typename Made>
requires std::is_arithmetic_v<Number> Number answer(const Call& call, CMPIStatus* status, Made make, const Number*) {
  Faults faults = {Fault::NullWithError, Fault::OtherNumber};
  if (status) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  call.noteAndThrow(faults);
  const Number number = make();
  if (call.fault == Fault::NullWithError || call.fault == Fault::GoodWithError) {
    setCode(status, injected);
  }
  switch (call.fault) {
    case Fault::NullWithError:
    case Fault::NullSilently:
      return 0;
    case Fault::OtherNumber:
      return std::is_same_v<Number, CMPIBoolean> ? static_cast<Number>(!number) : static_cast<Number>(number + 1);
    default:
      return number;
  }
}

// What else a slot may answer is passed on.
template <typename Other, typename Made>
requires(!std::is_arithmetic_v<Other> && !std::is_same_v<Other, CMPIData> && !std::is_same_v<Other, CMPIStatus> &&
         !std::is_pointer_v<Other>) Other answer(const Call& call, CMPIStatus*, Made make, const Other*) {
  call.noteAndThrow({});
  return make();
}

}  // namespace Testing
