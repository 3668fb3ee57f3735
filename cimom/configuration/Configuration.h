// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "cimom/configuration/Installation.h"

namespace Cimom {

// What cimomd works with, from its command line and its configuration file.
struct Configuration {
  std::string address = "127.0.0.1";
  std::uint16_t port = 5988;  // with TLS 5989, where none is given
  std::vector<std::filesystem::path> schemas;
  std::vector<std::filesystem::path> registrations;
  std::vector<std::filesystem::path> providerDirectories;
  std::size_t maxRequestSize = 4 << 20;     // bytes
  std::size_t maxRequestMemory = 32 << 20;  // bytes
  unsigned maxConnections = 512;
  unsigned maxConnectionsPerAddress = 64;
  unsigned maxRequests = 64;
  std::chrono::seconds idleTimeout{60};
  std::chrono::seconds requestTimeout{30};
  std::chrono::seconds operationTimeout{60};
  std::chrono::seconds shutdownTimeout{20};
  bool bare = false;                     // requests go to the providers unchecked
  std::vector<std::string> serverNames;  // beside the host's own
  std::filesystem::path tlsCertificate;  // empty: plain HTTP
  std::filesystem::path tlsKey;
  std::filesystem::path passwordFile;  // empty: everybody may
  std::filesystem::path requestLog;    // empty: none; "-": the standard output
  bool trace = false;
  std::string user;  // to run as; empty: as who starts it
};

// The command line or the configuration file is wrong; the text names the option, or file and line, and what is wrong.
class UsageError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// Reads cimomd's command line and the configuration file that it names, or the installed one where it names none:
// `key = value` lines, the keys named as the options are; what the command line says replaces what the file says, and a
// relative path in the file is relative to the file's directory. Schema, registration and provider directory are the
// installed ones where neither says otherwise; with no option and no file there is nothing to serve, which is an error.
// Returns nothing when help or the version was asked for, and has been printed. Throws UsageError.
std::optional<Configuration> readCommandLine(int argc, const char* const* argv, const Installation& installation);

// What that file and no option says.
Configuration readConfiguration(const std::filesystem::path& file, const Installation& installation);

}  // namespace Cimom
