// SPDX-License-Identifier: Apache-2.0
#include <QV/Instrumentation.h>

#include <exception>

#include "agent/backends/SharedBackEnd.h"
#include "agent/instrumentation/InterfaceCursor.h"
#include "agent/log/Report.h"

namespace QV {
namespace {

// Callers do not keep the text of what is thrown, and a destructor throws nothing: the log is where the reason stays.
void logFailure(const char* reason, const TWLog::SourceLocation& where = TWLog::SourceLocation::current()) noexcept {
  TWLog::report("Tarnwick.Instrumentation", TWLog::failureLevel, reason, where);
}

template <typename Operation>
auto logged(const Operation& operation, const TWLog::SourceLocation& where = TWLog::SourceLocation::current()) {
  try {
    return operation();
  } catch (const std::exception& error) {
    logFailure(error.what(), where);
    throw;
  }
}

}  // namespace

struct Instrumentation::State {
  InterfaceCursor cursor;
};

Instrumentation::Instrumentation() : state_(logged([] { return new State{InterfaceCursor(sharedBackEnd())}; })) {}

Instrumentation::~Instrumentation() {
  try {
    state_->cursor.flush();
  } catch (const std::exception& error) {
    logFailure(error.what());
  }
  delete state_;
}

void Instrumentation::selectNode(NodeLexicon::NodeType type) {
  logged([&] { state_->cursor.select(type); });
}

Instrumentation::operator bool() { return state_->cursor.onNode(); }

bool Instrumentation::getProperty(NodeLexicon::Properties property, std::string& value) {
  return logged([&] { return state_->cursor.get(property, value); });
}

void Instrumentation::operator++() {
  logged([&] { state_->cursor.advance(); });
}

bool Instrumentation::setProperty(NodeLexicon::Properties property, std::string& value) {
  return logged([&] { return state_->cursor.set(property, value); });
}

}  // namespace QV
