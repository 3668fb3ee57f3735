// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <chrono>
#include <memory_resource>
#include <new>
#include <optional>
#include <string_view>
#include <utility>

namespace Cimom {

// What every CMPI object that this object manager makes has in common: who frees it.
class Object {
 public:
  Object() = default;
  Object(const Object&) = delete;
  Object& operator=(const Object&) = delete;
  virtual ~Object() = default;

  // Owned by a scope or a caller's stack: releasing the object early is harmless and does nothing.
  bool inScope = false;
  Object* before = nullptr;  // the one that the scope made before it
};

// The moment after which up-calls fail; none: they never do.
using Deadline = std::optional<std::chrono::steady_clock::time_point>;

// The memory of one request. Every CMPI object that is made on this thread while the scope is the innermost one dies
// with it, and so does what the operations on such objects return. Scopes nest. Outside any scope an object belongs
// to who made it and goes with its release; a clone always does. A request may have a deadline, which the scopes inside
// it and the threads that its providers attach share.
class RequestScope {
 public:
  explicit RequestScope(const CMPIBroker* broker, Deadline deadline = {});
  ~RequestScope();
  RequestScope(const RequestScope&) = delete;
  RequestScope& operator=(const RequestScope&) = delete;

  // The request's context, at first without entries; it is made when first asked for.
  CMPIContext* context();

  // The innermost scope of this thread, or null.
  static RequestScope* current();
  // The broker of the innermost scope of this thread, or null.
  static const CMPIBroker* currentBroker();
  // The deadline of the innermost scope of this thread.
  static Deadline currentDeadline();

  // Makes an object that dies with the scope.
  template <typename Type, typename... Arguments>
  Type* make(Arguments&&... arguments) {
    void* place = memory_.allocate(sizeof(Type), alignof(Type));
    auto* object = new (place) Type(std::forward<Arguments>(arguments)...);
    object->inScope = true;
    object->before = std::exchange(last_, object);
    return object;
  }

  // Copies a text into the scope's memory and ends it with a null.
  const char* keep(std::string_view text) {
    auto* kept = static_cast<char*>(memory_.allocate(text.size() + 1, 1));
    kept[text.copy(kept, text.size())] = '\0';
    return kept;
  }

  // Opens a scope on this thread that a later call of `close`, or the end of an outer scope, ends.
  static RequestScope* open(const CMPIBroker* broker, Deadline deadline = {});
  // Ends an opened scope and those inside it. Returns false if it is not an open scope of this thread.
  static bool close(const RequestScope* opened);

 private:
  RequestScope(const CMPIBroker* broker, Deadline deadline, bool opened);

  const CMPIBroker* broker_;
  RequestScope* outer_;
  Deadline deadline_;
  bool opened_;
  CMPIContext* context_ = nullptr;
  std::pmr::monotonic_buffer_resource memory_;
  Object* last_ = nullptr;
};

}  // namespace Cimom
