// SPDX-License-Identifier: Apache-2.0
#include <csignal>
#include <iostream>

#include "bmcip/commands/Commands.h"
#include "bmcip/commands/Terminal.h"
#include "bmcip/output/Text.h"

namespace {

using namespace Bmcip;

constexpr int failure = 1;

int run(Options& options) {
  if (options.askPassword) {
    options.access.password = askPassword(options.access.user);
  }
  const bool hasLogin = !options.access.user.empty() || options.access.netrc;
  if (hasLogin && !options.server.isEncrypted() && !options.server.isThisMachine()) {
    std::cerr << "bmcip: the password goes to " << harmless(options.server.given)
              << " without encryption: use https://\n";
  }
  Transport transport(options.access);
  switch (options.command) {
    case Command::Show:
      return show(transport, options);
    case Command::Set:
      return set(transport, options);
    case Command::Watch:
      return watch(transport, options);
    case Command::Model:
      return model(transport, options);
  }
  return failure;
}

}  // namespace

int main(int argc, char** argv) {
  std::signal(SIGPIPE, SIG_IGN);
  try {
    auto options = readCommandLine(argc, argv);
    if (!options) {
      return 0;
    }
    try {
      return run(*options);
    } catch (const Failure& error) {
      std::cerr << "bmcip: " << harmless(options->server.given) << ": " << harmless(error.what()) << '\n';
      return static_cast<int>(error.kind());
    }
  } catch (const UsageError& error) {
    std::cerr << "bmcip: " << harmless(error.what()) << '\n';
    return usageStatus;
  } catch (const std::exception& error) {
    std::cerr << "bmcip: " << harmless(error.what()) << '\n';
    return failure;
  }
}
