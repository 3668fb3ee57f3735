// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/ScriptedInstrumentation.h"

#include <QV/Instrumentation.h>

#include <stdexcept>

namespace Testing {

InstrumentationScript& instrumentation() {
  static InstrumentationScript script;
  return script;
}

namespace {

void record(const std::string& call) {
  instrumentation().calls.push_back(call);
  if (instrumentation().throwAt == call) {
    throw std::runtime_error("scripted");
  }
}

}  // namespace

}  // namespace Testing

namespace QV {

struct Instrumentation::State {
  std::size_t position = 0;
};

Instrumentation::Instrumentation() : state_(nullptr) {
  Testing::record("construct");
  state_ = new State;
}

Instrumentation::~Instrumentation() {
  Testing::instrumentation().calls.push_back("destroy");
  delete state_;
}

void Instrumentation::selectNode(NodeLexicon::NodeType type) {
  Testing::record("selectNode(" + std::to_string(type) + ")");
}

Instrumentation::operator bool() {
  Testing::record("bool");
  return state_->position < Testing::instrumentation().nodes.size();
}

bool Instrumentation::getProperty(NodeLexicon::Properties property, std::string& value) {
  Testing::record("getProperty(" + std::to_string(property) + ")");
  const Testing::ScriptedNode& node = Testing::instrumentation().nodes.at(state_->position);
  if (!node.name) {
    ++state_->position;
    return false;
  }
  value = *node.name;
  return true;
}

void Instrumentation::operator++() {
  Testing::record("++");
  ++state_->position;
}

bool Instrumentation::setProperty(NodeLexicon::Properties property, std::string& value) {
  Testing::record("setProperty(" + std::to_string(property) + ", " + value + ")");
  Testing::instrumentation().nodes.at(state_->position).values[property] = value;
  return true;
}

}  // namespace QV
