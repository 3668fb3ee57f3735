// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/BrokerCore.h"

#include <array>
#include <iostream>
#include <string>

#include "cimom/model/Errors.h"
#include "ground/Printable.h"

namespace Cimom {
namespace {

void logToStandardError(int severity, std::string_view component, std::string_view text) {
  constexpr std::array<const char*, 5> names = {"message", "error", "info", "warning", "debug"};
  const auto number = static_cast<std::size_t>(severity);
  const auto index = number < names.size() ? number : 0;
  std::string line = std::string(names[index]) + ": ";
  if (!component.empty()) {
    line.append(Ground::printable(component)).append(": ");
  }
  // One write, so that the lines of several threads stay whole.
  std::cerr << line.append(Ground::printable(text)).append("\n") << std::flush;
}

}  // namespace

BrokerCore::BrokerCore()
    : log(logToStandardError), broker{this, &upCallTable, &encapsulationTable, &extensionTable, &memoryTable} {}

const ClassDefinition& BrokerCore::requireClass(std::string_view nameSpace, std::string_view className) const {
  const ClassDefinition* definition = classes.find(nameSpace, className);
  if (!definition && !classes.hasNamespace(nameSpace)) {
    definition = classes.find(className);
  }
  if (!definition) {
    throw StatusError(CMPI_RC_ERR_INVALID_CLASS, "unknown class \"" + std::string(className) + "\"");
  }
  return *definition;
}

void BrokerCore::requireNamespace(std::string_view nameSpace) const {
  if (!classes.hasNamespace(nameSpace)) {
    throw StatusError(CMPI_RC_ERR_INVALID_NAMESPACE, "unknown namespace \"" + std::string(nameSpace) + "\"");
  }
}

void logError(const BrokerCore& core, std::string_view text) {
  if (core.log) {
    core.log(CMPI_SEV_ERROR, "cimomd", text);
  }
}

BrokerCore& coreOf(const CMPIBroker* broker) {
  if (!broker || !broker->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, "CMPIBroker must not be null");
  }
  return *static_cast<BrokerCore*>(broker->hdl);
}

}  // namespace Cimom
