#include <QV/ProviderHelper.h>
#include <unistd.h>

#include <array>
#include <exception>

#include "agent/config/AgentConfiguration.h"

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

std::string hostName() {
  std::array<char, 256> name{};
  if (::gethostname(name.data(), name.size() - 1) != 0 || !name[0]) {
    return "localhost";
  }
  return name.data();
}

}  // namespace

std::string getSystemName() {
  // Asked for with every object path, so agent.ini is read once. The host name may change while we run.
  static const std::string configured = configuredName();
  return configured.empty() ? hostName() : configured;
}

}  // namespace QV
