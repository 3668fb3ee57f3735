// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "tests/support/system/Process.h"

namespace Testing {

// An instance as `wbemcli -nl` prints it: its path, and the properties that have a value as they stand there (texts in
// quotes). `names` holds those without one too.
struct Printed {
  std::string path;
  std::map<std::string, std::string> values;
  std::vector<std::string> names;
};

// Reads what `wbemcli -nl` printed of instances.
std::vector<Printed> instancesOf(const std::string& output);

// The lines that are not empty.
std::vector<std::string> linesOf(const std::string& output);

// A path as wbemcli prints it, "host/namespace:Class.keys", without the host and the namespace.
std::string objectOf(const std::string& path);

// A path as wbemcli prints it, without the host.
std::string withoutHost(const std::string& path);

// wbemcli, talking to an object manager on a port of 127.0.0.1.
class WbemClient {
 public:
  virtual ~WbemClient() = default;

  virtual std::uint16_t port() const = 0;

  // "http://127.0.0.1:PORT/NAMESPACE:OBJECT", as wbemcli takes it.
  std::string url(const std::string& object, const std::string& nameSpace = "root/cimv2") const;

  // Runs wbemcli; a space is what `operation` is split at.
  Completed wbemcli(const std::string& operation, const std::string& object, const std::vector<std::string>& more = {},
                    const std::string& nameSpace = "root/cimv2") const;

  // What a wbemcli that must succeed answers: paths as they are printed; paths without host and namespace; instances.
  std::vector<std::string> paths(const std::string& operation, const std::string& object,
                                 const std::string& nameSpace = "root/cimv2") const;
  std::vector<std::string> names(const std::string& operation, const std::string& object,
                                 const std::string& nameSpace = "root/cimv2") const;
  std::vector<Printed> instances(const std::string& operation, const std::string& object,
                                 const std::string& properties = {}, const std::string& nameSpace = "root/cimv2") const;

  // The properties that have a value of the one instance that GetInstance answers.
  std::map<std::string, std::string> get(const std::string& object, const std::string& nameSpace = "root/cimv2") const;

  // ModifyInstance of "Name=value,..." pairs, which must succeed.
  void modify(const std::string& object, const std::string& values) const;

  // What a wbemcli that must fail says.
  std::string failure(const std::string& operation, const std::string& object,
                      const std::vector<std::string>& more = {}, const std::string& nameSpace = "root/cimv2") const;
};

}  // namespace Testing
