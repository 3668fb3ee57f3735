// SPDX-License-Identifier: Apache-2.0
// What the command line, the environment and the configuration file ask for.
#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "bmcip/client/Server.h"
#include "bmcip/client/Transport.h"

namespace Bmcip {

// A mistake in the command line, in a configuration file, or in what a change asks for; exit status 2.
class UsageError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

inline constexpr int usageStatus = 2;

enum class Command { Show, Set, Watch, Model };

struct Options {
  Command command = Command::Show;
  bool json = false;

  Server server;  // what is asked where no other one is named
  Access access;
  bool askPassword = false;  // the user is known, the password is not

  std::vector<std::string> hosts;  // show
  std::string hostsFile;
  std::size_t parallel = 256;

  std::string interface;  // set
  std::string newAddress;
  std::string newMask;
  bool dryRun = false;
  bool yes = false;
  std::chrono::milliseconds wait = std::chrono::seconds(10);

  std::chrono::milliseconds interval = std::chrono::seconds(2);  // watch

  std::string svgFile;  // model
};

// Nothing after --help or --version, which are answered here. Throws UsageError.
std::optional<Options> readCommandLine(int argc, const char* const* argv);

}  // namespace Bmcip
