// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/SharedBackEnd.h"

#include <dlfcn.h>

#include <exception>
#include <filesystem>
#include <stdexcept>
#include <string>

#include "agent/backends/NamedProcessor.h"
#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/config/AgentConfiguration.h"
#include "agent/log/Report.h"
#include "ground/Settings.h"

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
  // The deleter holds the library, so its code outlives the object. What is thrown is made anew before the library
  // goes, which holds the code of its exceptions, too.
  try {
    return {create(settings), [library](BackEnd* backEnd) { delete backEnd; }};
  } catch (const Ground::RefusedSetting& refused) {
    throw Ground::RefusedSetting(refused);
  } catch (const std::exception& error) {
    throw std::runtime_error(error.what());
  }
}

// Reported as a failure, so that it is seen: whoever takes made-up values for a processor's must be able to learn it.
std::shared_ptr<BackEnd> simulate(const BackEndSettings& settings) {
  const std::string state = parseSimulatedSettings(settings);
  auto backEnd = std::make_shared<SimulatedBackEnd>(state);
  TWLog::report("Tarnwick.SimulatedProcessor", TWLog::failureLevel,
                "the management processor is simulated (" + agentConfigurationFile() +
                    ": backend = simulated): its values are made up, and changes reach no hardware but " + state);
  return backEnd;
}

// A back end knows its keys, the agent the file and the line on which they stand.
std::shared_ptr<BackEnd> openBackEnd(const AgentConfiguration& configuration) {
  const std::string& choice = configuration.backEnd;
  try {
    return choice == "simulated" ? simulate(configuration.backEndSettings)
                                 : load(choice, configuration.backEndSettings);
  } catch (const Ground::RefusedSetting& refused) {
    const auto line = configuration.backEndLines.find(refused.key());
    throw std::runtime_error(agentConfigurationFile() +
                             (line == configuration.backEndLines.end() ? "" : ":" + std::to_string(line->second)) +
                             ": [" + choice + "] " + refused.withoutPlace());
  }
}

std::shared_ptr<BackEnd> createBackEnd() {
  const AgentConfiguration configuration = readAgentConfiguration();
  const std::string& choice = configuration.backEnd;
  if (choice.empty()) {
    throw std::runtime_error(agentConfigurationFile() +
                             ": [processor] has no key 'backend', so that there is no management processor; set "
                             "backend = ipmi for a BMC, or backend = simulated for made-up values");
  }
  const std::string& description = configuration.processorDescription;
  // With this the log is there before the back end is, and outlives it: that may have something to say when it ends.
  TWLog::trace("Tarnwick.Instrumentation", TWLog::progressLevel,
               "the management processor is reached by the back end " + choice);
  return std::make_shared<NamedProcessor>(openBackEnd(configuration), configuration.processorName,
                                          choice == "simulated" ? describedAsSimulated(description) : description);
}

}  // namespace

std::shared_ptr<BackEnd> sharedBackEnd() {
  static const std::shared_ptr<BackEnd> backEnd = createBackEnd();
  return backEnd;
}

}  // namespace QV
