#pragma once

#include <map>
#include <string>
#include <vector>

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

}  // namespace Testing
