#include "cimom/configuration/Settings.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <limits>
#include <utility>

namespace Cimom {
namespace {

using Apply = std::function<void(Configuration&, const GivenValue&)>;

std::uint64_t parseNumber(const GivenValue& value, std::uint64_t least, std::uint64_t most) {
  std::uint64_t number = 0;
  const char* end = value.text.data() + value.text.size();
  const auto result = std::from_chars(value.text.data(), end, number);
  if (result.ec == std::errc() && result.ptr == end && number >= least && number <= most) {
    return number;
  }
  throw UsageError(value.origin + ": \"" + value.text + "\" is no number from " + std::to_string(least) + " to " +
                   std::to_string(most));
}

std::filesystem::path parsePath(const GivenValue& value) {
  if (value.text.empty()) {
    throw UsageError(value.origin + ": the path is empty");
  }
  return value.base / value.text;
}

template <typename Number>
Apply number(Number Configuration::*member, std::uint64_t least, std::uint64_t most) {
  return [=](Configuration& configuration, const GivenValue& value) {
    configuration.*member = Number(parseNumber(value, least, most));
  };
}

Apply path(std::filesystem::path Configuration::*member) {
  return [=](Configuration& configuration, const GivenValue& value) { configuration.*member = parsePath(value); };
}

Apply paths(std::vector<std::filesystem::path> Configuration::*member) {
  return [=](Configuration& configuration, const GivenValue& value) {
    (configuration.*member).push_back(parsePath(value));
  };
}

}  // namespace

const std::vector<Setting>& settings() {
  constexpr std::uint64_t day = 86400;
  static const std::vector<Setting> table = {
      {"address", "ADDRESS", "numeric address to listen on (127.0.0.1)", false,
       [](Configuration& configuration, const GivenValue& value) { configuration.address = value.text; }},
      {"port", "N", "port to listen on; 0 takes a free one (5988)", false, number(&Configuration::port, 0, 65535)},
      {"schema", "PATH", "MOF file, or directory of *.mof files, with the classes", true,
       paths(&Configuration::schemas)},
      {"registration", "FILE", "registration of providers", true, paths(&Configuration::registrations)},
      {"provider-dir", "DIR", "directory with the providers' libraries", true,
       paths(&Configuration::providerDirectories)},
      {"max-request-size", "BYTES", "largest body of a request (4194304)", false,
       number(&Configuration::maxRequestSize, 1024, std::numeric_limits<std::int32_t>::max())},
      {"max-connections", "N", "connections served at once (64)", false,
       number(&Configuration::maxConnections, 1, 4096)},
      {"idle-timeout", "SECONDS", "a connection without traffic for so long is closed (60)", false,
       number(&Configuration::idleTimeout, 1, day)},
      {"shutdown-timeout", "SECONDS", "how long the end waits for requests that are being answered (20)", false,
       number(&Configuration::shutdownTimeout, 0, day)},
      {"tls-certificate", "FILE", "PEM file with the certificate chain; with tls-key, HTTPS instead of HTTP", false,
       path(&Configuration::tlsCertificate)},
      {"tls-key", "FILE", "PEM file with the certificate's private key", false, path(&Configuration::tlsKey)},
      {"password-file", "FILE", "file of user:hash lines (crypt(5)); who is not in it is refused", false,
       path(&Configuration::passwordFile)}};
  return table;
}

const Setting* findSetting(std::string_view name) {
  const auto setting = std::find_if(settings().begin(), settings().end(),
                                    [name](const Setting& candidate) { return candidate.name == name; });
  return setting == settings().end() ? nullptr : &*setting;
}

Configuration toConfiguration(const GivenValues& given) {
  Configuration configuration;
  for (const Setting& setting : settings()) {
    const auto values = given.find(std::string_view(setting.name));
    if (values == given.end()) {
      continue;
    }
    if (!setting.repeatable && values->second.size() > 1) {
      throw UsageError(values->second[1].origin + " is given twice");
    }
    for (const GivenValue& value : values->second) {
      setting.apply(configuration, value);
    }
  }
  if (configuration.tlsCertificate.empty() != configuration.tlsKey.empty()) {
    throw UsageError("tls-certificate and tls-key go together");
  }
  return configuration;
}

}  // namespace Cimom
