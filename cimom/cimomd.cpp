// SPDX-License-Identifier: Apache-2.0
#include <signal.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iostream>
#include <iterator>
#include <memory>

#include "cimom/ObjectManager.h"
#include "cimom/cimxml/Endpoint.h"
#include "cimom/configuration/Configuration.h"
#include "cimom/http/PasswordFile.h"
#include "cimom/http/Server.h"
#include "ground/HostName.h"

namespace {

using namespace Cimom;

constexpr int failure = 1;
constexpr int usageError = 2;

// The signals that end the program, taken by the main thread alone.
class EndSignals {
 public:
  // Threads that start later inherit the mask, so it is set before any.
  EndSignals() {
    sigemptyset(&signals_);
    sigaddset(&signals_, SIGTERM);
    sigaddset(&signals_, SIGINT);
    pthread_sigmask(SIG_BLOCK, &signals_, nullptr);
    signal(SIGPIPE, SIG_IGN);
  }

  void wait() const {
    int received = 0;
    sigwait(&signals_, &received);
  }

 private:
  sigset_t signals_{};
};

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
  manager.checkProviders();
}

std::string contentOf(const std::filesystem::path& file) {
  if (file.empty()) {
    return {};
  }
  std::ifstream stream(file, std::ios::binary);
  std::string content{std::istreambuf_iterator<char>(stream), {}};
  if (!content.empty()) {
    return content;
  }
  if (!stream.is_open()) {
    throw Http::ServerError(file.string() + ": " + std::strerror(errno));
  }
  throw Http::ServerError(file.string() + (std::filesystem::is_directory(file) ? ": is a directory" : ": is empty"));
}

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
  options.hostNames = {configuration.serverNames.begin(), configuration.serverNames.end()};
  options.hostNames.insert(Ground::hostName());
  options.tlsCertificate = contentOf(configuration.tlsCertificate);
  options.tlsKey = contentOf(configuration.tlsKey);
  if (!configuration.passwordFile.empty()) {
    options.authenticator = [passwords = std::make_shared<Http::PasswordFile>(configuration.passwordFile)](
                                const std::string& user, const std::string& password) {
      return passwords->accepts(user, password);
    };
  }
  return options;
}

void serve(const Configuration& configuration, const EndSignals& endSignals) {
  ObjectManager manager;
  load(manager, configuration);
  const CimXml::Endpoint endpoint(manager.broker(), manager.classes(), Ground::hostName());
  Http::ServerOptions options = serverOptions(configuration);
  options.failureHandler = [&endpoint](const Http::Request& request, const std::string& why) {
    return endpoint.fail(request, why);
  };
  Http::Server server(std::move(options),
                      [&endpoint](const Http::Request& request) { return endpoint.handle(request); });
  std::cout << "listening on " << server.endpoint() << std::endl;
  endSignals.wait();
  if (server.drain(configuration.shutdownTimeout)) {
    return;
  }
  // A provider that is still at work can neither be cleaned up nor unloaded.
  std::cerr << "cimomd: shutting down without provider cleanup: requests still in progress after "
            << configuration.shutdownTimeout.count() << " s" << std::endl;
  std::_Exit(failure);
}

}  // namespace

int main(int argc, char** argv) {
  try {
    const auto configuration = readCommandLine(argc, argv, thisInstallation());
    if (!configuration) {
      return 0;
    }
    const EndSignals endSignals;
    serve(*configuration, endSignals);
    return 0;
  } catch (const UsageError& error) {
    std::cerr << "cimomd: " << error.what() << "\n";
    return usageError;
  } catch (const std::exception& error) {
    std::cerr << "cimomd: " << error.what() << "\n";
    return failure;
  }
}
