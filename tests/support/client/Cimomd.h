// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"

namespace Testing {

// A running cimomd on a free port of 127.0.0.1, stopped at the latest with this object: as its administrator stops it,
// and killed where it does not end so.
class Cimomd {
 public:
  // Waits until it listens. Throws std::runtime_error with what it wrote to the standard error where it ends instead.
  // @param options further options; --port is given already
  explicit Cimomd(const std::vector<std::string>& options, const Environment& environment = {},
                  const std::string& program = built("bin/cimomd"));
  ~Cimomd();

  // Options with which it serves the probe provider and its classes, in root/test.
  static std::vector<std::string> probeOptions();

  std::uint16_t port() const { return port_; }
  Process& process() { return process_; }

  // "http://127.0.0.1:PORT/NAMESPACE:OBJECT", as wbemcli takes it.
  std::string url(const std::string& object, const std::string& nameSpace = "root/test") const;

  // Runs wbemcli: an operation and its options, the object, and what follows it.
  Completed wbemcli(std::vector<std::string> operation, const std::string& object,
                    const std::vector<std::string>& more = {}) const;

  // Ends it with SIGTERM and returns its exit status.
  int stop();

 private:
  Process process_;
  std::uint16_t port_ = 0;
};

}  // namespace Testing
