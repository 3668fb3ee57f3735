#include "QV/Instrumentation.h"

#include <exception>
#include <experimental/source_location>

#include "TWLog/TWLog.h"
#include "instrumentation/InterfaceCursor.h"
#include "instrumentation/SharedBackEnd.h"

namespace QV {
namespace {

// Callers do not keep the text of what is thrown, and a destructor throws nothing: the log is where the reason stays.
void logFailure(const char* reason, const std::experimental::source_location& where) noexcept {
  try {
    const std::string component = "Tarnwick.Instrumentation";
    const std::string text = reason;
    const auto line = static_cast<int>(where.line());
    TWLog::TWLogger::logLevelMessage(where.function_name(), "Instrumentation", line, component, 6000, nullptr, 0, 0,
                                     text);
    TWLog::TWLogger::traceLevelMessage(where.function_name(), "Instrumentation", line, component, 6000, nullptr, 0, 0,
                                       text);
  } catch (const std::exception&) {
    // Out of memory: the failure itself is still thrown to the caller.
  }
}

template <typename Operation>
auto logged(const Operation& operation,
            std::experimental::source_location where = std::experimental::source_location::current()) {
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
    logFailure(error.what(), std::experimental::source_location::current());
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
