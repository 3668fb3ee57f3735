// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Calls.h"

#include <stdexcept>
#include <utility>

namespace Testing {

Calls& calls() {
  static Calls running;
  return running;
}

void Calls::begin(CallKey key, Fault fault) {
  target_ = key;
  fault_ = fault;
  recording_ = false;
  fired_ = false;
  occurrences_.clear();
  objects_.clear();
  names_.clear();
  recorded_.clear();
  violations_.clear();
}

void Calls::beginRecording() {
  begin(0, Fault::None);
  recording_ = true;
}

CallKey Calls::hashOf(const char* text) {
  CallKey hash = 0xcbf29ce484222325ULL;
  for (; *text; ++text) {
    hash = (hash ^ static_cast<unsigned char>(*text)) * 0x100000001b3ULL;
  }
  return hash;
}

CallKey Calls::keyOfObject(const void* object) const {
  const auto found = objects_.find(object);
  return found == objects_.end() ? 0 : found->second;
}

std::string Calls::textOfObject(const void* object) const {
  const auto found = names_.find(object);
  return found == names_.end() ? "" : ' ' + found->second;
}

Calls::Call Calls::enter(CallKey key, std::string text) {
  Call call;
  call.key = key;
  call.fault = Fault::None;
  call.calls_ = this;
  if (fault_ != Fault::None && key == target_ && !fired_) {
    call.fault = fault_;
    fired_ = true;
  }
  if (recording_) {
    call.index_ = recorded_.size();
    recorded_.push_back({key, std::move(text), {}});
  }
  return call;
}

void Calls::Call::note(Faults faults) const {
  if (calls_->recording_) {
    faults.push_back(Fault::StandardException);
    faults.push_back(Fault::ForeignException);
    calls_->recorded_[index_].faults = std::move(faults);
  }
}

void Calls::Call::noteAndThrow(Faults faults) const {
  note(std::move(faults));
  if (fault == Fault::StandardException) {
    throw std::runtime_error("injected");
  }
  if (fault == Fault::ForeignException) {
    throw 42;
  }
}

void Calls::adopt(const void* object, const Call& call) {
  objects_[object] = call.key;
  if (recording_) {
    names_[object] = recorded_[call.index_].text;
  }
}

void Calls::know(const void* object, const char* name) {
  objects_[object] = hashOf(name);
  if (recording_) {
    names_[object] = name;
  }
}

}  // namespace Testing
