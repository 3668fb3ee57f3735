#include "agent/backends/SharedBackEnd.h"

#include <dlfcn.h>

#include <filesystem>
#include <mutex>
#include <stdexcept>
#include <string>

#include "agent/backends/NamedProcessor.h"
#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/config/AgentConfiguration.h"

namespace QV {
namespace {

constexpr const char* ipmiLibrary = "libqvbmc-ipmi.so";

// The IPMI back end lies beside this library; the plain name lets the loader's own search find it elsewhere.
std::string ipmiLibraryPath() {
  Dl_info self{};
  if (::dladdr(reinterpret_cast<const void*>(&sharedBackEnd), &self) != 0 && self.dli_fname) {
    const auto neighbour = std::filesystem::absolute(self.dli_fname).parent_path() / ipmiLibrary;
    std::error_code unreadable;
    if (std::filesystem::exists(neighbour, unreadable)) return neighbour;
  }
  return ipmiLibrary;
}

// Only an installation that talks IPMI needs the library behind it, which is why it is loaded and not linked.
std::shared_ptr<BackEnd> loadIpmi(const BackEndSettings& settings) {
  const std::shared_ptr<void> library(::dlopen(ipmiLibraryPath().c_str(), RTLD_NOW | RTLD_LOCAL),
                                      [](void* handle) { handle ? ::dlclose(handle) : 0; });
  if (!library) throw std::runtime_error("the IPMI back end cannot be loaded: " + std::string(::dlerror()));
  auto* create = reinterpret_cast<CreateBackEnd*>(::dlsym(library.get(), "qvCreateBackEnd"));
  if (!create) throw std::runtime_error("the IPMI back end cannot be used: " + std::string(::dlerror()));
  // The deleter holds the library, so its code outlives the object.
  return {create(settings), [library](BackEnd* backEnd) { delete backEnd; }};
}

std::shared_ptr<BackEnd> createBackEnd() {
  const AgentConfiguration configuration = readAgentConfiguration();
  std::shared_ptr<BackEnd> backEnd;
  if (configuration.backEnd == AgentConfiguration::BackEndKind::Ipmi)
    backEnd = loadIpmi(configuration.ipmi);
  else
    backEnd = std::make_shared<SimulatedBackEnd>(configuration.simulatedState);
  return std::make_shared<NamedProcessor>(backEnd, configuration.processorName, configuration.processorDescription);
}

}  // namespace

std::shared_ptr<BackEnd> sharedBackEnd() {
  static std::mutex mutex;
  static std::shared_ptr<BackEnd> backEnd;
  const std::lock_guard lock(mutex);
  if (!backEnd) backEnd = createBackEnd();
  return backEnd;
}

}  // namespace QV
