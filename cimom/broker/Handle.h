// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

#include "cimom/broker/Models.h"
#include "cimom/broker/RequestScope.h"
#include "cimom/model/Errors.h"
#include "cimom/model/Instance.h"
#include "cimom/model/Shared.h"

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

// How a model stands behind its object: paths, instances and arrays are shared with the values that they came from or
// went to.
template <typename Model>
struct Held {
  using Type = Model;
};
template <>
struct Held<ObjectPath> {
  using Type = Shared<ObjectPath>;
};
template <>
struct Held<Instance> {
  using Type = Shared<Instance>;
};
template <>
struct Held<Array> {
  using Type = Shared<Array>;
};

// A CMPI object: the struct that providers see, and the model behind it. The struct's handle is this object, but for
// strings it is the characters, as providers that read a string's handle directly expect.
template <typename Model>
struct Handle final : Object, Abi<Model>::Type {
  explicit Handle(typename Held<Model>::Type contents, bool ownedElsewhere = false) : model(std::move(contents)) {
    inScope = ownedElsewhere;
    if constexpr (std::is_same_v<Model, Text>) {
      this->hdl = const_cast<char*>(model.characters);
    } else {
      this->hdl = this;
    }
    this->ft = &Abi<Model>::table;
  }

  typename Held<Model>::Type model;
};

// A CMPI object for the time of a call, on the caller's stack.
template <typename Model>
Handle<Model> lend(Model model) {
  return Handle<Model>(std::move(model), true);
}
template <typename Model>
Handle<Model> lend(Shared<Model> model) {
  return Handle<Model>(std::move(model), true);
}

// What is behind a CMPI object.
// Throws StatusError CMPI_RC_ERR_INVALID_HANDLE if the object or its handle is null.
template <typename Model>
typename Held<Model>::Type& heldBy(const typename Abi<Model>::Type* object) {
  static_assert(!std::is_same_v<Model, Text>, "textOf reads a string");
  if (!object || !object->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, std::string(Abi<Model>::name) + " must not be null");
  }
  return static_cast<Handle<Model>*>(object->hdl)->model;
}

// The same for an object that a slot is given to act with, not on.
// Throws StatusError CMPI_RC_ERR_INVALID_PARAMETER if the object or its handle is null.
template <typename Model>
const typename Held<Model>::Type& argumentOf(const typename Abi<Model>::Type* object) {
  if (!object || !object->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string(Abi<Model>::name) + " must not be null");
  }
  return heldBy<Model>(object);
}

// The model behind a CMPI object. Throws as heldBy does.
template <typename Model>
const Model& modelOf(const typename Abi<Model>::Type* object) {
  if constexpr (std::is_same_v<typename Held<Model>::Type, Model>) {
    return heldBy<Model>(object);
  } else {
    return *heldBy<Model>(object);
  }
}

// The same, to be changed. Throws as heldBy does.
template <typename Model>
Model& ownModelOf(const typename Abi<Model>::Type* object) {
  if constexpr (std::is_same_v<typename Held<Model>::Type, Model>) {
    return heldBy<Model>(object);
  } else {
    return heldBy<Model>(object).own();
  }
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
  if (RequestScope* scope = RequestScope::current()) {
    return scope->make<Handle<Model>>(std::move(model));
  }
  return new Handle<Model>(std::move(model));
}
template <typename Model>
typename Abi<Model>::Type* make(Shared<Model> model) {
  if (RequestScope* scope = RequestScope::current()) {
    return scope->make<Handle<Model>>(std::move(model));
  }
  return new Handle<Model>(std::move(model));
}

// Makes a string of a copy of the text.
inline CMPIString* makeCopy(std::string_view text) {
  if (RequestScope* scope = RequestScope::current()) {
    return scope->make<Handle<Text>>(Text(Text::Kept{scope->keep(text)}));
  }
  return new Handle<Text>(Text(std::string(text)));
}

}  // namespace Cimom
