// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpimacs.h>

#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "cimom/ObjectManager.h"

namespace Testing {

// What a provider was called with: the operation's name and all that came along, as text.
struct Call {
  std::string operation;
  std::string path;
  std::string associationClass;  // "(null)" if null came
  std::string resultClass;
  std::string role;
  std::string resultRole;
  std::vector<std::string> properties;
  bool hasProperties = false;
};

// A provider linked into the test that records its calls and answers as the test has set it up to. What it answers with
// goes through the macros that any provider uses. It is shared with the object managers that it serves, which clean it
// up when they end. Threads may call it side by side; what it has recorded is read when they have returned.
class RecordingProvider : public std::enable_shared_from_this<RecordingProvider> {
 public:
  // Answers a call of the operation; the instance is null if the operation has none.
  using Answer =
      std::function<CMPIStatus(const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*)>;

  RecordingProvider();
  RecordingProvider(const RecordingProvider&) = delete;
  RecordingProvider& operator=(const RecordingProvider&) = delete;

  // Registers the probe for a class; the provider's name is the class's.
  void serve(Cimom::ObjectManager& manager, const std::string& className, const std::string& nameSpace,
             bool association = false);

  // What a factory of the test's own returns.
  CMPIInstanceMI* instanceMi() { return &instanceMi_; }

  const CMPIBroker* broker = nullptr;  // what the factory was given
  Answer answer;                       // by default OK, and nothing returned
  std::vector<Call> calls;
  std::function<CMPIStatus()> cleanUp;  // by default OK
  int factoryCalls = 0;
  int cleanups = 0;

 private:
  struct Slots;

  CMPIStatus cleaned();

  std::mutex mutex_;  // of `calls`
  CMPIInstanceMI instanceMi_;
  CMPIAssociationMI associationMi_;
};

constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};

// The text of a string, "(null)" if there is none.
std::string shownText(const CMPIString* string);

// The texts that the paths, or the instances' paths, of an enumeration show.
std::vector<std::string> pathsOf(CMPIEnumeration* enumeration);

}  // namespace Testing
