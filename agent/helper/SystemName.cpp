#include <QV/ProviderHelper.h>

#include <exception>

#include "agent/config/AgentConfiguration.h"
#include "ground/HostName.h"

namespace QV {
namespace {

// A path needs some host, whatever is wrong with agent.ini or missing: the log reports that.
std::string configuredName() {
  try {
    return readAgentConfiguration().systemName;
  } catch (const std::exception&) {
    return {};
  }
}

}  // namespace

std::string getSystemName() {
  // Asked for with every object path, so agent.ini is read once. The host name may change while we run.
  static const std::string configured = configuredName();
  return configured.empty() ? Ground::hostName() : configured;
}

}  // namespace QV
