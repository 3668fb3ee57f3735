#include <QV/ProviderHelper.h>
#include <unistd.h>

#include <array>
#include <exception>

#include "agent/config/AgentConfiguration.h"

namespace QV {
namespace {

// A broken agent.ini counts as none here, since a path needs some host: the log reports the file.
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
