// SPDX-License-Identifier: Apache-2.0
// Feeds the server any bytes as a connection, up to the broker: it replies or closes, and answers the next client.
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <memory>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/cimxml/Endpoint.h"
#include "cimom/http/Server.h"
#include "ground/Descriptor.h"

namespace {

using namespace Cimom;

// The probe's schema without its provider: an operation runs up to the up-call.
std::unique_ptr<ObjectManager> loadManager() {
  auto loaded = std::make_unique<ObjectManager>();
  std::ifstream mof(SOURCE_DIR "/tests/support/probe/Probe.mof");
  loaded->loadSchemaText(std::string{std::istreambuf_iterator<char>(mof), {}}, "root/test", "Probe.mof");
  return loaded;
}

// Whoever gives a name may ask.
Http::ServerOptions options() {
  Http::ServerOptions options;
  options.maxRequestSize = 64 << 10;
  options.authenticator = [](const std::string&, const std::string&) { return true; };
  return options;
}

struct Target {
  std::unique_ptr<ObjectManager> manager = loadManager();
  CimXml::Endpoint endpoint{manager->broker(), manager->classes(), "host"};
  Http::Server server{options(), [this](const Http::Request& request) { return endpoint.handle(request); }};
};

// How much the server sends until it closes the connection: of itself, or at the end of what it is sent.
std::size_t exchange(Http::Server& server, const std::uint8_t* data, std::size_t size, bool ends) {
  std::array<int, 2> sockets{};
  if (socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, sockets.data()) != 0) {
    std::abort();
  }
  const Ground::Descriptor client(sockets[0]);
  server.adopt(sockets[1]);
  // libFuzzer's clock interrupts what waits.
  const auto retried = [](auto call) {
    ssize_t result = 0;
    do {
      result = call();
    } while (result < 0 && errno == EINTR);
    return result;
  };
  // The socket takes what the fuzzer makes at once.
  if (size > 0 && retried([&] { return send(client.number(), data, size, MSG_NOSIGNAL); }) < 0) {
    return 0;
  }
  if (ends) {
    shutdown(client.number(), SHUT_WR);
  }
  std::array<char, 4096> buffer{};
  std::size_t received = 0;
  ssize_t count = 0;
  while ((count = retried([&] { return read(client.number(), buffer.data(), buffer.size()); })) > 0) {
    received += static_cast<std::size_t>(count);
  }
  return received;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static Target target;
  exchange(target.server, data, size, true);
  constexpr char next[] = "GET / HTTP/1.0\r\n\r\n";
  if (exchange(target.server, reinterpret_cast<const std::uint8_t*>(next), sizeof next - 1, false) == 0) {
    std::abort();
  }
  return 0;
}
