// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <memory>
#include <string>
#include <type_traits>
#include <utility>

#include "cimom/broker/Models.h"
#include "cimom/broker/RequestScope.h"
#include "cimom/model/Errors.h"
#include "cimom/model/Instance.h"

namespace Cimom {

// Which CMPI object a model is behind: its struct, its function table and its name.
template <typename Model>
struct Abi;

#define CIMOM_ABI(MODEL, OBJECT)                 \
  template <>                                    \
  struct Abi<MODEL> {                            \
    using Type = OBJECT;                         \
    static OBJECT##FT table;                     \
    static constexpr const char* name = #OBJECT; \
  }

CIMOM_ABI(Text, CMPIString);
CIMOM_ABI(ObjectPath, CMPIObjectPath);
CIMOM_ABI(Instance, CMPIInstance);
CIMOM_ABI(Array, CMPIArray);
CIMOM_ABI(Enumeration, CMPIEnumeration);
CIMOM_ABI(Args, CMPIArgs);
CIMOM_ABI(DateTime, CMPIDateTime);
CIMOM_ABI(Context, CMPIContext);
CIMOM_ABI(Result, CMPIResult);
CIMOM_ABI(Error, CMPIError);

#undef CIMOM_ABI

// A CMPI object: the struct that providers see, and the model behind it. The struct's handle is this object, but for
// strings it is the characters, as providers that read a string's handle directly expect.
template <typename Model>
struct Handle final : Object, Abi<Model>::Type {
  explicit Handle(Model contents, bool ownedElsewhere = false) : model(std::move(contents)) {
    inScope = ownedElsewhere;
    if constexpr (std::is_same_v<Model, Text>) {
      this->hdl = model.characters.data();
    } else {
      this->hdl = this;
    }
    this->ft = &Abi<Model>::table;
  }

  Model model;
};

// A CMPI object for the time of a call, on the caller's stack.
template <typename Model>
Handle<Model> lend(Model model) {
  return Handle<Model>(std::move(model), true);
}

// The model behind a CMPI object.
// Throws StatusError CMPI_RC_ERR_INVALID_HANDLE if the object or its handle is null.
template <typename Model>
Model& modelOf(const typename Abi<Model>::Type* object) {
  static_assert(!std::is_same_v<Model, Text>, "textOf reads a string");
  if (!object || !object->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, std::string(Abi<Model>::name) + " must not be null");
  }
  return static_cast<Handle<Model>*>(object->hdl)->model;
}

// The same for an object that a slot is given to act with, not on.
// Throws StatusError CMPI_RC_ERR_INVALID_PARAMETER if the object or its handle is null.
template <typename Model>
Model& argumentOf(const typename Abi<Model>::Type* object) {
  if (!object || !object->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string(Abi<Model>::name) + " must not be null");
  }
  return modelOf<Model>(object);
}

// The characters of a CMPI string.
// Throws StatusError CMPI_RC_ERR_INVALID_HANDLE if the string or its handle is null.
inline const char* textOf(const CMPIString* string) {
  if (!string || !string->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, "CMPIString must not be null");
  }
  return static_cast<const char*>(string->hdl);
}

// Makes a CMPI object, owned by the current request scope if there is one and else by the caller.
template <typename Model>
typename Abi<Model>::Type* make(Model model) {
  auto handle = std::make_unique<Handle<Model>>(std::move(model));
  auto* object = handle.get();
  if (RequestScope* scope = RequestScope::current()) {
    scope->adopt(std::move(handle));
    return object;
  }
  return handle.release();
}

}  // namespace Cimom
