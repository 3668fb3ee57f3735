// SPDX-License-Identifier: Apache-2.0
#include <malloc.h>
#include <netdb.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <iostream>
#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/ObjectManager.h"
#include "cimom/broker/ProviderFrame.h"
#include "cimom/cimxml/Endpoint.h"
#include "cimom/configuration/Configuration.h"
#include "cimom/daemon/Account.h"
#include "cimom/daemon/RequestLog.h"
#include "cimom/daemon/Signals.h"
#include "cimom/http/PasswordFile.h"
#include "cimom/http/Server.h"
#include "cimom/interop/InteropProvider.h"
#include "ground/FileContent.h"
#include "ground/HostName.h"
#include "ground/Names.h"
#include "ground/Printable.h"

namespace {

using namespace Cimom;

constexpr int failure = 1;
constexpr int usageError = 2;

void load(ObjectManager& manager, const Configuration& configuration) {
  for (const auto& schema : configuration.schemas) {
    manager.loadSchema(schema);
  }
  for (const auto& registration : configuration.registrations) {
    manager.loadRegistration(registration);
  }
  for (const auto& directory : configuration.providerDirectories) {
    manager.addProviderDirectory(directory);
  }
  manager.setStrictness(configuration.bare ? Strictness::Bare : Strictness::Exact);
  // They stand with the classes: in the same directory, or beside a file by the same name.
  std::vector<Profile> profiles;
  for (std::filesystem::path path : configuration.schemas) {
    if (std::filesystem::is_directory(path) || std::filesystem::exists(path.replace_extension(".profiles"))) {
      std::ranges::move(readProfiles(path), std::back_inserter(profiles));
    }
  }
  const LinkedProvider interop = interopProvider(manager.classes(), {Ground::hostName(), CIMOMD_VERSION, profiles});
  for (const ProviderRegistration& registration : interop.registrations) {
    manager.addProvider(registration, interop.instanceFactory, interop.associationFactory);
  }
  manager.checkProviders();
}

void log(const std::string& line) {
  // One write, so that the lines of several threads stay whole.
  std::cerr << "cimomd: " + line + "\n" << std::flush;
}

void trace(int, std::string_view component, std::string_view text) {
  std::cerr << "trace: " + Ground::printable(component) + ": " + Ground::printable(text) + "\n" << std::flush;
}

// The host's name, and with TLS, where other machines may ask, the one that the network knows it by.
std::set<std::string, Ground::NameLess> hostNames(const Configuration& configuration) {
  std::set<std::string, Ground::NameLess> names(configuration.serverNames.begin(), configuration.serverNames.end());
  const std::string own = Ground::hostName();
  names.insert(own);
  addrinfo hints{};
  hints.ai_flags = AI_CANONNAME;
  addrinfo* found = nullptr;
  if (!configuration.tlsCertificate.empty() && getaddrinfo(own.c_str(), nullptr, &hints, &found) == 0) {
    if (found->ai_canonname) {
      names.insert(found->ai_canonname);
    }
    freeaddrinfo(found);
  }
  return names;
}

// The files that are read again on SIGHUP.
class Files {
 public:
  explicit Files(const Configuration& configuration) : configuration_(configuration) {
    if (!configuration.passwordFile.empty()) {
      passwords_ = std::make_shared<Http::PasswordFile>(configuration.passwordFile);
    }
    if (!configuration.requestLog.empty()) {
      requestLog_ = std::make_unique<RequestLog>(configuration.requestLog);
    }
  }

  void use(Http::ServerOptions& options) {
    if (!configuration_.tlsCertificate.empty()) {
      options.tlsCertificate = Ground::readFile(configuration_.tlsCertificate);
      options.tlsKey = Ground::readSecretFile(configuration_.tlsKey);
    }
    if (passwords_) {
      options.authenticator = [this](const std::string& user, const std::string& password) {
        return passwords()->accepts(user, password);
      };
    }
    if (requestLog_) {
      options.requestLog = [this](const Http::RequestRecord& record) { requestLog_->write(record); };
    }
  }

  void reload(Http::Server& server) {
    if (passwords_) {
      attempt([&] {
        auto read = std::make_shared<const Http::PasswordFile>(configuration_.passwordFile);
        const std::lock_guard lock(mutex_);
        passwords_.swap(read);
      });
    }
    if (!configuration_.tlsCertificate.empty()) {
      attempt([&] {
        server.useCertificate(Ground::readFile(configuration_.tlsCertificate),
                              Ground::readSecretFile(configuration_.tlsKey));
      });
    }
    if (requestLog_) {
      attempt([&] { requestLog_->reopen(); });
    }
    log("passwords, certificate and request log have been read again");
  }

 private:
  template <typename Step>
  static void attempt(Step step) {
    try {
      step();
    } catch (const std::exception& error) {
      log(std::string(error.what()) + "; what was read before stays in use");
    }
  }

  std::shared_ptr<const Http::PasswordFile> passwords() {
    const std::lock_guard lock(mutex_);
    return passwords_;
  }

  const Configuration& configuration_;
  std::mutex mutex_;
  std::shared_ptr<const Http::PasswordFile> passwords_;
  std::unique_ptr<RequestLog> requestLog_;
};

Http::ServerOptions serverOptions(const Configuration& configuration) {
  Http::ServerOptions options;
  options.address = configuration.address;
  options.port = configuration.port;
  options.maxRequestSize = configuration.maxRequestSize;
  options.maxRequestMemory = configuration.maxRequestMemory;
  options.maxConnections = configuration.maxConnections;
  options.maxConnectionsPerAddress = configuration.maxConnectionsPerAddress;
  options.maxRequests = configuration.maxRequests;
  options.idleTimeout = configuration.idleTimeout;
  options.requestTimeout = configuration.requestTimeout;
  options.operationTimeout = configuration.operationTimeout;
  options.hostNames = hostNames(configuration);
  options.log = &log;
  return options;
}

// A body or a reply of this size is a mapping of its own, which is the system's again as soon as it is freed. Left
// alone the allocator raises the size with every such block, until even the largest stay in its pools. What requests
// usually take stays there for the next one.
void boundKeptMemory() {
  mallopt(M_MMAP_THRESHOLD, 256 << 10);
  mallopt(M_TRIM_THRESHOLD, 4 << 20);
}

void chooseUser(const Configuration& configuration) {
  if (!configuration.user.empty()) {
    becomeUser(configuration.user);
  } else if (geteuid() == 0) {
    log("runs as root: user = NAME lets it run as another user, user = root says that it is meant");
  }
}

void serve(const Configuration& configuration, Signals& signals) {
  boundKeptMemory();
  chooseUser(configuration);
  ObjectManager manager;
  if (configuration.trace) {
    manager.setTrace(&trace);
  }
  load(manager, configuration);
  const CimXml::Endpoint endpoint(manager.broker(), manager.classes(), Ground::hostName());
  Files files(configuration);
  Http::ServerOptions options = serverOptions(configuration);
  files.use(options);
  options.failureHandler = [&endpoint](const Http::Request& request, const std::string& why) {
    return endpoint.fail(request, why);
  };
  options.threadEnd = &ProviderFrame::endedBy;
  Http::Server server(std::move(options),
                      [&endpoint](const Http::Request& request) { return endpoint.handle(request); });
  signals.serving();
  std::cout << "listening on " << server.endpoint() << std::endl;
  while (signals.wait() == Signals::Wish::Reload) {
    files.reload(server);
  }
  if (server.drain(configuration.shutdownTimeout)) {
    return;
  }
  // A provider that is still at work can neither be cleaned up nor unloaded.
  log("shutting down without provider cleanup: requests still in progress after " +
      std::to_string(configuration.shutdownTimeout.count()) + " s");
  std::_Exit(failure);
}

}  // namespace

int main(int argc, char** argv) {
  try {
    const auto configuration = readCommandLine(argc, argv, thisInstallation());
    if (!configuration) {
      return 0;
    }
    static Signals signals;  // its thread lives as long as the program
    serve(*configuration, signals);
    return 0;
  } catch (const UsageError& error) {
    std::cerr << "cimomd: " << error.what() << "\n";
    return usageError;
  } catch (const std::exception& error) {
    std::cerr << "cimomd: " << error.what() << "\n";
    return failure;
  }
}
