#ifndef CIMOM_BROKER_BROKERCORE_H_
#define CIMOM_BROKER_BROKERCORE_H_

#include <cmpift.h>

#include <string_view>

#include "cimom/broker/MessageSink.h"
#include "cimom/providers/ProviderRegistry.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom {

/// What stands behind the broker that providers see.
struct BrokerCore {
  BrokerCore();

  /// @throws StatusError CMPI_RC_ERR_INVALID_CLASS
  const ClassDefinition& requireClass(std::string_view className) const;
  /// @throws StatusError CMPI_RC_ERR_INVALID_NAMESPACE
  void requireNamespace(std::string_view nameSpace) const;

  ClassRepository classes;
  MessageSink log;
  MessageSink trace;
  CMPIBroker broker;
  ProviderRegistry providers;
};

/// @throws StatusError CMPI_RC_ERR_INVALID_HANDLE where the broker or its handle is null
BrokerCore& coreOf(const CMPIBroker* broker);

/// The broker's four function tables.
extern CMPIBrokerFT upCallTable;
extern CMPIBrokerEncFT encapsulationTable;
extern CMPIBrokerExtFT extensionTable;
extern CMPIBrokerMemFT memoryTable;

}  // namespace Cimom

#endif  // CIMOM_BROKER_BROKERCORE_H_
