// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace Bmcip {

// Where an object manager listens, and the namespace of the classes there.
struct Server {
  std::string given = "http://localhost:5988";  // as the user wrote it
  std::string scheme = "http";
  std::string host = "localhost";  // an IPv6 address in brackets
  std::string port = "5988";
  std::string nameSpace = "root/cimv2";

  bool isEncrypted() const { return scheme == "https"; }
  bool isThisMachine() const;  // by its name
  std::string url() const { return scheme + "://" + host + ":" + port; }
};

// "[SCHEME://]HOST[:PORT][/NAMESPACE]". What is missing is taken from the defaults; another scheme brings its own port,
// 5988 or 5989. Throws std::invalid_argument with the reason.
Server parseServer(const std::string& text, const Server& defaults = {});

}  // namespace Bmcip
