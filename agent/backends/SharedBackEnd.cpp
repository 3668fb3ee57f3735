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

// Back ends are installed in a directory of their own beside this library, and built into the same one; the plain name
// lets the loader's own search find it elsewhere.
std::string pathOf(const std::string& libraryName) {
  Dl_info self{};
  if (::dladdr(reinterpret_cast<const void*>(&sharedBackEnd), &self) != 0 && self.dli_fname) {
    const auto here = std::filesystem::absolute(self.dli_fname).parent_path();
    for (const auto& directory : {here / "compositeipconfig", here}) {
      std::error_code unreadable;
      if (std::filesystem::exists(directory / libraryName, unreadable)) {
        return directory / libraryName;
      }
    }
  }
  return libraryName;
}

// Only an installation that uses a back end needs the libraries behind it, which is why it is loaded and not linked.
std::shared_ptr<BackEnd> load(const std::string& name, const BackEndSettings& settings) {
  const std::string libraryName = "libqvbmc-" + name + ".so";
  const std::shared_ptr<void> library(::dlopen(pathOf(libraryName).c_str(), RTLD_NOW | RTLD_LOCAL),
                                      [](void* handle) { handle ? ::dlclose(handle) : 0; });
  if (!library) {
    throw std::runtime_error("the back end " + name + " cannot be loaded: " + ::dlerror() + "; install " + libraryName +
                             ", or correct backend in [processor] of agent.ini");
  }
  auto* create = reinterpret_cast<CreateBackEnd*>(::dlsym(library.get(), "qvCreateBackEnd"));
  if (!create) {
    throw std::runtime_error("the back end " + name + " cannot be used: " + ::dlerror());
  }
  // The deleter holds the library, so its code outlives the object.
  return {create(settings), [library](BackEnd* backEnd) { delete backEnd; }};
}

std::shared_ptr<BackEnd> createBackEnd() {
  const AgentConfiguration configuration = readAgentConfiguration();
  const BackEndSettings& settings = configuration.backEndSettings;
  const std::shared_ptr<BackEnd> backEnd = configuration.backEnd == "simulated"
                                               ? std::make_shared<SimulatedBackEnd>(parseSimulatedSettings(settings))
                                               : load(configuration.backEnd, settings);
  return std::make_shared<NamedProcessor>(backEnd, configuration.processorName, configuration.processorDescription);
}

}  // namespace

std::shared_ptr<BackEnd> sharedBackEnd() {
  static std::mutex mutex;
  static std::shared_ptr<BackEnd> backEnd;
  const std::lock_guard lock(mutex);
  if (!backEnd) {
    backEnd = createBackEnd();
  }
  return backEnd;
}

}  // namespace QV
