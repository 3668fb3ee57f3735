#include "tests/e2e/support/Wbem.h"

#include <sstream>

namespace Testing {

std::vector<std::string> linesOf(const std::string& output) {
  std::vector<std::string> lines;
  std::istringstream stream(output);
  for (std::string line; std::getline(stream, line);)
    if (!line.empty()) lines.push_back(line);
  return lines;
}

std::vector<Printed> instancesOf(const std::string& output) {
  std::vector<Printed> instances;
  for (const std::string& line : linesOf(output)) {
    if (line.front() != '-') {
      instances.push_back({line, {}, {}});
      continue;
    }
    const auto equals = line.find('=');
    const std::string name = line.substr(1, equals - 1);
    instances.back().names.push_back(name);
    if (equals + 1 < line.size()) instances.back().values[name] = line.substr(equals + 1);
  }
  return instances;
}

std::string withoutHost(const std::string& path) { return path.substr(path.find('/') + 1); }

std::string objectOf(const std::string& path) {
  const std::string local = withoutHost(path);
  return local.substr(local.find(':') + 1);
}

}  // namespace Testing
