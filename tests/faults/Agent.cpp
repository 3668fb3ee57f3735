// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Agent.h"

#include <QV/Instrumentation.h>
#include <QV/ProviderHelper.h>
#include <TWLog/TWLog.h>

#include <utility>

#include "tests/faults/Allocations.h"
#include "tests/faults/Calls.h"

namespace Testing {

Agent& agent() {
  static Agent running;
  return running;
}

}  // namespace Testing

// The helper's own sources, compiled under another name.
namespace RealQV {

enum DataType { Uint16 = 1, Uint8 = 2, String = 8 };

void mapProperty(CMPIData source, CMPIInstance* target, const char* name, DataType type, CMPIStatus* status);
bool isObjPathsEqual(const CMPIObjectPath* requested, const CMPIObjectPath* candidate, bool flag);
bool textEqual(const char* a, const char* b);

}  // namespace RealQV

using Testing::agent;
using Testing::calls;
using Testing::CountedAllocations;
using Testing::Fault;

namespace QV {

void mapProperty(CMPIData source, CMPIInstance* target, const char* name, DataType type, CMPIStatus* status) {
  const CountedAllocations notTheLibrarys(false);
  const CMPIInstance* item = source.type == CMPI_instance ? source.value.inst : nullptr;
  const auto call = calls().meet("mapProperty", item, static_cast<const CMPIInstance*>(target), name);
  call.noteAndThrow({Fault::ReturnsNothing, Fault::FailsUndone});
  if (call.fault == Fault::FailsUndone && status) {
    *status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  }
  if (call.fault == Fault::None) {
    RealQV::mapProperty(source, target, name, static_cast<RealQV::DataType>(type), status);
  }
}

std::string getSystemName() {
  const CountedAllocations notTheLibrarys(false);
  const auto call = calls().meet("getSystemName");
  call.noteAndThrow({Fault::ReturnsNothing});
  return call.fault == Fault::ReturnsNothing ? "" : "system.example";
}

bool isObjPathsEqual(const CMPIObjectPath* requested, const CMPIObjectPath* candidate, bool flag) {
  const CountedAllocations notTheLibrarys(false);
  const auto call = calls().meet("isObjPathsEqual", requested, candidate, flag);
  call.noteAndThrow({Fault::ReturnsNothing, Fault::OtherNumber});
  if (call.fault == Fault::ReturnsNothing) {
    return false;
  }
  const bool equal = RealQV::isObjPathsEqual(requested, candidate, flag);
  return call.fault == Fault::OtherNumber ? !equal : equal;
}

bool textEqual(const char* a, const char* b) {
  const CountedAllocations notTheLibrarys(false);
  const auto call = calls().meet("textEqual", a, b);
  call.noteAndThrow({Fault::ReturnsNothing, Fault::OtherNumber});
  if (call.fault == Fault::ReturnsNothing) {
    return false;
  }
  return RealQV::textEqual(a, b) != (call.fault == Fault::OtherNumber);
}

namespace {

void record(const std::string& call) { agent().record->instrumentation.push_back(call); }

}  // namespace

struct Instrumentation::State {
  std::size_t position = 0;
};

Instrumentation::Instrumentation() : state_(nullptr) {
  const CountedAllocations notTheLibrarys(false);
  record("construct");
  calls().meet("Instrumentation").noteAndThrow({});
  state_ = new State;
}

Instrumentation::~Instrumentation() {
  const CountedAllocations notTheLibrarys(false);
  record("destroy");
  delete state_;
}

void Instrumentation::selectNode(NodeLexicon::NodeType type) {
  const CountedAllocations notTheLibrarys(false);
  record("selectNode(" + std::to_string(type) + ")");
  const auto call = calls().meet("selectNode");
  call.noteAndThrow({Fault::ReturnsNothing});
  state_->position = call.fault == Fault::ReturnsNothing ? agent().nodes.size() : 0;
}

Instrumentation::operator bool() {
  const CountedAllocations notTheLibrarys(false);
  record("bool");
  const auto call = calls().meet("operator bool");
  call.noteAndThrow({Fault::ReturnsNothing});
  return call.fault == Fault::None && state_->position < agent().nodes.size();
}

bool Instrumentation::getProperty(NodeLexicon::Properties property, std::string& value) {
  const CountedAllocations notTheLibrarys(false);
  record("getProperty(" + std::to_string(property) + ")");
  const auto call = calls().meet("Instrumentation::getProperty", static_cast<int>(property));
  call.noteAndThrow({Fault::ReturnsNothing, Fault::FailsDone});
  const auto& name = agent().nodes.at(state_->position);
  if (!name || call.fault == Fault::ReturnsNothing) {
    ++state_->position;
    return false;
  }
  // Read, and denied: the cursor has moved all the same.
  value = *name;
  if (call.fault == Fault::FailsDone) {
    ++state_->position;
    return false;
  }
  return true;
}

void Instrumentation::operator++() {
  const CountedAllocations notTheLibrarys(false);
  record("++");
  calls().meet("operator++").noteAndThrow({});
  ++state_->position;
}

bool Instrumentation::setProperty(NodeLexicon::Properties property, std::string& value) {
  const CountedAllocations notTheLibrarys(false);
  record("setProperty(" + std::to_string(property) + ", " + value + ") of node " + std::to_string(state_->position));
  const auto call = calls().meet("Instrumentation::setProperty", static_cast<int>(property));
  call.noteAndThrow({Fault::ReturnsNothing});
  return call.fault == Fault::None;
}

}  // namespace QV

namespace TWLog {

TWMessageBuffer::TWMessageBuffer() {
  const CountedAllocations notTheLibrarys(false);
  calls().meet("TWMessageBuffer").noteAndThrow({});
}

TWMessageBuffer::~TWMessageBuffer() = default;

TWMessageBuffer& TWMessageBuffer::operator<<(const char* text) {
  const CountedAllocations notTheLibrarys(false);
  const auto call = calls().meet("TWMessageBuffer::operator<<");
  call.noteAndThrow({Fault::UndoneSilently});
  if (call.fault == Fault::None) {
    text_ += text;
  }
  return *this;
}

std::string str(TWMessageBuffer& buffer) {
  const CountedAllocations notTheLibrarys(false);
  const auto call = calls().meet("str");
  call.noteAndThrow({Fault::ReturnsNothing});
  std::string text = std::exchange(buffer.text_, {});
  return call.fault == Fault::None ? text : "";
}

namespace {

void send(bool trace, const char* function, const char* file, int line, const std::string& component, int level,
          const char* unused, int first, int second, const std::string& message) {
  const CountedAllocations notTheLibrarys(false);
  const auto call = calls().meet(trace ? "traceLevelMessage" : "logLevelMessage");
  call.noteAndThrow({Fault::UndoneSilently});
  if (unused || first != 0 || second != 0) {
    calls().violation("the logger is called with more than a line");
  }
  if (call.fault == Fault::None) {
    agent().record->lines.push_back({trace, function, file, line, component, level, message});
  }
}

}  // namespace

void TWLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& component,
                               int level, char* unused, int first, int second, const std::string& message) {
  send(false, function, file, line, component, level, unused, first, second, message);
}

void TWLogger::traceLevelMessage(const char* function, const char* file, int line, const std::string& component,
                                 int level, char* unused, int first, int second, const std::string& message) {
  send(true, function, file, line, component, level, unused, first, second, message);
}

}  // namespace TWLog
