// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <exception>

#include "cimom/broker/CmpiValue.h"
#include "cimom/broker/Handle.h"

namespace Cimom {

// Makes a status. Its message belongs to the request; outside any request there is nobody to own it and it is null.
inline CMPIStatus makeStatus(CMPIrc code, const char* message) noexcept {
  CMPIStatus status = {code, nullptr};
  try {
    if (message && RequestScope::current()) {
      status.msg = make(Text{message});
    }
  } catch (const std::exception&) {
    // The code alone still says what is wrong.
  }
  return status;
}

// Runs what stands behind a slot of a function table: no exception passes the binary interface. What may pass is the
// unwinding of a thread that a provider ends (ProviderFrame.h), which a noexcept here would turn into the process's
// end.
template <typename Operation>
CMPIStatus guarded(Operation operation) {
  try {
    operation();
    return {CMPI_RC_OK, nullptr};
  } catch (const StatusError& error) {
    return makeStatus(error.code(), error.what());
  } catch (const std::exception& error) {
    return makeStatus(CMPI_RC_ERR_FAILED, error.what());
  }
}

// The same for a slot that returns a result and reports through a status pointer, which may be null.
template <typename Given, typename Operation>
Given guarded(CMPIStatus* status, Given failure, Operation operation) {
  Given result = failure;
  const CMPIStatus outcome = guarded([&] { result = operation(); });
  if (status) {
    *status = outcome;
  }
  return result;
}

// A name or text that a slot requires.
// Throws StatusError CMPI_RC_ERR_INVALID_PARAMETER if it is null.
inline const char* required(const char* text, const char* what) {
  if (!text) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string(what) + " must not be null");
  }
  return text;
}

// What a slot returns that has no value to return.
constexpr CMPIData noData = {CMPI_null, CMPI_nullValue | CMPI_notFound, {}};

// The slots `release` and `clone`, the same for every object.
template <typename Model>
CMPIStatus release(typename Abi<Model>::Type* object) {
  if (!object || !object->hdl) {
    return makeStatus(CMPI_RC_ERR_INVALID_HANDLE, "cannot release a null object");
  }
  auto* handle = static_cast<Handle<Model>*>(object);
  if (!handle->inScope) {
    delete handle;
  }
  return {CMPI_RC_OK, nullptr};
}

template <typename Model>
typename Abi<Model>::Type* clone(const typename Abi<Model>::Type* object, CMPIStatus* status) {
  using Type = typename Abi<Model>::Type;
  return guarded(status, static_cast<Type*>(nullptr), [&]() -> Type* {
    if constexpr (std::is_same_v<Model, Text>) {
      return new Handle<Text>(Text{textOf(object)});
    } else {
      return new Handle<Model>(heldBy<Model>(object));
    }
  });
}

// A string of the request; null if there is no text.
inline CMPIString* makeText(const std::optional<std::string>& text) { return text ? make(Text{*text}) : nullptr; }

// An entry of named values by index, as the slots get…At return it.
// Throws StatusError CMPI_RC_ERR_NO_SUCH_PROPERTY past the end.
inline CMPIData entryAt(const NamedValues& values, CMPICount index, CMPIString** name,
                        CMPIValueState state = CMPI_goodValue) {
  if (index >= values.size()) {
    throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, "no entry at index " + std::to_string(index));
  }
  const auto& entry = values[index];
  const CMPIData data = toCmpi(entry.value, state);
  if (name) {
    *name = makeCopy(entry.name);
  }
  return data;
}

// An entry of named values by name, as the slots get… return it.
// Throws StatusError CMPI_RC_ERR_NO_SUCH_PROPERTY if there is none.
inline CMPIData entryOf(const NamedValues& values, const char* name, CMPIValueState state = CMPI_goodValue) {
  const Value* value = values.find(required(name, "the name"));
  if (!value) {
    throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, std::string("no entry \"") + name + "\"");
  }
  return toCmpi(*value, state);
}

}  // namespace Cimom
