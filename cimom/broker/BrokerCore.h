// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <functional>
#include <string_view>

#include "cimom/schema/ClassRepository.h"

namespace Cimom {

class OperationHandler;

// Takes a message that a provider logs or traces: its severity (CMPI_SEV_…) or level (CMPI_LEV_…), the component that
// sends it and the text. It may be called from several threads at once.
using MessageSink = std::function<void(int level, std::string_view component, std::string_view text)>;

// What stands behind the broker that providers see.
struct BrokerCore {
  BrokerCore();

  // The class as the namespace shows it, or wherever it is if the namespace is none that is known.
  // Throws StatusError CMPI_RC_ERR_INVALID_CLASS.
  const ClassDefinition& requireClass(std::string_view nameSpace, std::string_view className) const;
  // Throws StatusError CMPI_RC_ERR_INVALID_NAMESPACE.
  void requireNamespace(std::string_view nameSpace) const;

  ClassRepository classes;
  MessageSink log;  // at first a line on the standard error output
  MessageSink trace;
  OperationHandler* operations = nullptr;  // who carries up-calls out; there before the first of them
  CMPIBroker broker;
};

// Logs what the object manager itself has to say.
void logError(const BrokerCore& core, std::string_view text);

// Throws StatusError CMPI_RC_ERR_INVALID_HANDLE if the broker or its handle is null.
BrokerCore& coreOf(const CMPIBroker* broker);

// The broker's four function tables.
extern CMPIBrokerFT upCallTable;
extern CMPIBrokerEncFT encapsulationTable;
extern CMPIBrokerExtFT extensionTable;
extern CMPIBrokerMemFT memoryTable;

}  // namespace Cimom
