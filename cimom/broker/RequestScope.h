// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <memory>
#include <vector>

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
};

// The memory of one request. Every CMPI object that is made on this thread while the scope is the innermost one dies
// with it, and so does what the operations on such objects return. Scopes nest. Outside any scope an object belongs
// to who made it and goes with its release; a clone always does.
class RequestScope {
 public:
  explicit RequestScope(const CMPIBroker* broker);
  ~RequestScope();
  RequestScope(const RequestScope&) = delete;
  RequestScope& operator=(const RequestScope&) = delete;

  // The request's context, at first without entries; it is made when first asked for.
  CMPIContext* context();

  // The innermost scope of this thread, or null.
  static RequestScope* current();
  // The broker of the innermost scope of this thread, or null.
  static const CMPIBroker* currentBroker();

  void adopt(std::unique_ptr<Object> object);

  // Opens a scope on this thread that a later call of `close`, or the end of an outer scope, ends.
  static RequestScope* open(const CMPIBroker* broker);
  // Ends an opened scope and those inside it. Returns false if it is not an open scope of this thread.
  static bool close(const RequestScope* opened);

 private:
  RequestScope(const CMPIBroker* broker, bool opened);

  const CMPIBroker* broker_;
  RequestScope* outer_;
  bool opened_;
  CMPIContext* context_ = nullptr;
  std::vector<std::unique_ptr<Object>> objects_;
};

}  // namespace Cimom
