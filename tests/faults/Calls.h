// SPDX-License-Identifier: Apache-2.0
// The calls that one run makes, of the object manager and of the agent's libraries, and the one of them that fails.
//
// A call is known by what it is, not by its place: its name, the object that it is made on, its arguments, and how
// often the same was asked before. An object is known by the call that returned it. So the same call is found in
// another run, and in the run of another program that makes the same calls in another order.
#pragma once

#include <cstdint>
#include <string>
#include <type_traits>
#include <unordered_map>
#include <vector>

#include "tests/faults/Fault.h"

namespace Testing {

using CallKey = std::uint64_t;

struct RecordedCall {
  CallKey key;
  std::string text;  // what was called, for a reader
  Faults faults;     // that it can have
};

class Calls {
 public:
  // Begins a run in which the call of that key has the fault; none fails with Fault::None.
  void begin(CallKey key, Fault fault);
  // Begins a run without a fault that keeps every call.
  void beginRecording();

  const std::vector<RecordedCall>& recorded() const { return recorded_; }
  bool fired() const { return fired_; }

  // What the library did that no run may do, such as calling an object without a handle.
  const std::vector<std::string>& violations() const { return violations_; }
  void violation(const std::string& what) { violations_.push_back(what); }

  // One call under way: its key, and the fault that it has.
  class Call {
   public:
    CallKey key;
    Fault fault;

    // Keeps the call with the faults that it can have, where the run records.
    void note(Faults faults) const;
    // The same, and throws where the fault is an exception.
    void noteAndThrow(Faults faults) const;

   private:
    friend class Calls;
    Calls* calls_ = nullptr;
    std::size_t index_ = 0;
  };

  template <typename... Arguments>
  Call meet(const char* name, const Arguments&... arguments) {
    CallKey key = hashOf(name);
    ((key = mix(key, keyOf(arguments))), ...);
    key = mix(key, static_cast<CallKey>(++occurrences_[key]));
    std::string text;
    if (recording_) {
      text = name;
      text += '(';
      ((text += textOf(arguments)), ...);
      text += ')';
    }
    return enter(key, std::move(text));
  }

  // Makes the object known by the call that returned it.
  void adopt(const void* object, const Call& call);
  void know(const void* object, const char* name);

 private:
  static CallKey mix(CallKey a, CallKey b) {
    return (a ^ (b + 0x9e3779b97f4a7c15ULL + (a << 6) + (a >> 2))) * 0x100000001b3ULL;
  }
  static CallKey hashOf(const char* text);

  // Arguments that say which call it is: texts, objects and numbers. What is pointed at otherwise says nothing.
  template <typename T>
  CallKey keyOf(const T& argument) const {
    if constexpr (std::is_same_v<T, const char*>) {
      return argument ? hashOf(argument) : 1;
    } else if constexpr (std::is_pointer_v<T>) {
      return keyOfObject(argument);
    } else if constexpr (std::is_convertible_v<T, CallKey>) {
      return static_cast<CallKey>(argument);
    } else {
      return 0;
    }
  }
  template <typename T>
  std::string textOf(const T& argument) const {
    if constexpr (std::is_same_v<T, const char*>) {
      return argument ? std::string(" \"") + argument + '"' : " null";
    } else if constexpr (std::is_pointer_v<T>) {
      return textOfObject(argument);
    } else if constexpr (std::is_convertible_v<T, CallKey>) {
      return ' ' + std::to_string(static_cast<CallKey>(argument));
    } else {
      return {};
    }
  }

  CallKey keyOfObject(const void* object) const;
  std::string textOfObject(const void* object) const;
  Call enter(CallKey key, std::string text);

  CallKey target_ = 0;
  Fault fault_ = Fault::None;
  bool recording_ = false;
  bool fired_ = false;
  std::unordered_map<CallKey, int> occurrences_;
  std::unordered_map<const void*, CallKey> objects_;
  std::unordered_map<const void*, std::string> names_;
  std::vector<RecordedCall> recorded_;
  std::vector<std::string> violations_;
};

// The calls of the run that is under way.
Calls& calls();

}  // namespace Testing
