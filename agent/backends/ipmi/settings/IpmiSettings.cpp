// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/settings/IpmiSettings.h"

#include <freeipmi/freeipmi.h>

#include <algorithm>
#include <charconv>
#include <map>
#include <optional>
#include <set>
#include <stdexcept>

#include "ground/FileContent.h"
#include "ground/Settings.h"

namespace QV::Ipmi {
namespace {

using Ground::Settings;

constexpr const char* place = "agent.ini, [ipmi]";
constexpr std::size_t longestUser = 16;
constexpr std::size_t longestSecret = 20;

// A suite is offered where it authenticates, protects and encrypts: the others leave the password or the change of an
// address to whoever listens.
const std::set<std::uint64_t> soundCipherSuites = {3, 8, 12, 17};

const std::set<std::string> commonKeys = {
    "connection", "channels",       "ipv6", "operation_timeout", "session_timeout", "retransmission_timeout",
    "cache",      "generation_file"};
const std::set<std::string> inBandKeys = {"device"};
const std::set<std::string> lanKeys = {"host",     "port",         "user",      "password_file",
                                       "k_g_file", "cipher_suite", "privilege", "workarounds"};

void refuseForeignKeys(const Settings& settings, const BackEndSettings& section, IpmiSettings::Connection connection) {
  const bool lan = connection == IpmiSettings::Connection::Lan;
  for (const auto& [key, value] : section) {
    if (commonKeys.contains(key) || (lan ? lanKeys : inBandKeys).contains(key)) {
      continue;
    }
    if ((lan ? inBandKeys : lanKeys).contains(key)) {
      settings.refuse(key, value, std::string("the key belongs to connection = ") + (lan ? "inband" : "lan"));
    }
    settings.refuse(key, value, "there is no such key");
  }
}

ChannelChoice parseChannels(const std::string& value) {
  if (value == "auto") {
    return {ChannelChoice::Mode::InUse, {}};
  }
  if (value == "all") {
    return {ChannelChoice::Mode::All, {}};
  }
  std::set<std::uint8_t> channels;
  for (const std::string& word : Ground::parseList(value)) {
    channels.insert(static_cast<std::uint8_t>(Ground::parseNumber(word, 1, 11)));
  }
  return {ChannelChoice::Mode::Listed, {channels.begin(), channels.end()}};
}

// What libfreeipmi can do about BMCs that do not keep to the standard, by the names that FreeIPMI's own tools use: its
// flags for RMCP+ sessions.
unsigned parseWorkarounds(const std::string& value) {
  static const std::vector<std::pair<std::string, unsigned>> flags = {
      {"authcap", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_AUTHENTICATION_CAPABILITIES},
      {"integritycheckvalue", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_NON_EMPTY_INTEGRITY_CHECK_VALUE},
      {"intel20", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_INTEL_2_0_SESSION},
      {"nochecksumcheck", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_NO_CHECKSUM_CHECK},
      {"opensesspriv", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_OPEN_SESSION_PRIVILEGE},
      {"sun20", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_SUN_2_0_SESSION},
      {"supermicro20", IPMI_WORKAROUND_FLAGS_OUTOFBAND_2_0_SUPERMICRO_2_0_SESSION}};
  unsigned workarounds = 0;
  for (const std::string& name : Ground::parseList(value)) {
    workarounds |= Ground::parseChoice(name, flags);
  }
  return workarounds;
}

void readLan(const Settings& section, IpmiSettings& settings) {
  settings.host = section.required("host");
  section.number("port", settings.port, 1, 65535);
  settings.user = section.required("user");
  if (settings.user.size() > longestUser) {
    section.refuse("user", settings.user, "IPMI allows at most 16 bytes");
  }
  settings.passwordFile = section.required("password_file");
  section.text("k_g_file", settings.keyFile);
  section.number("cipher_suite", settings.cipherSuite, 0, 255);
  if (!soundCipherSuites.contains(settings.cipherSuite)) {
    section.refuse("cipher_suite", std::to_string(settings.cipherSuite),
                   "only 3, 8, 12 and 17 authenticate, protect and encrypt");
  }
  section.choice<std::uint8_t>("privilege", settings.privilege, {{"user", 2}, {"operator", 3}, {"admin", 4}});
  section.take("workarounds", [&](const std::string& value) { settings.workarounds = parseWorkarounds(value); });
  readPassword(settings);
  readKey(settings);
}

void readTimes(const Settings& section, IpmiSettings& settings) {
  using namespace std::chrono_literals;
  section.seconds("operation_timeout", settings.operationTimeout, 100ms, 60s);
  // libfreeipmi sees that the session time-out is over up to two retransmissions late. These defaults leave the time to
  // say why no session opens before the operation's own is over.
  settings.sessionTimeout = settings.operationTimeout * 3 / 5;
  section.seconds("session_timeout", settings.sessionTimeout, 40ms, settings.operationTimeout);
  settings.retransmissionTimeout = std::min(settings.retransmissionTimeout, settings.sessionTimeout / 6);
  section.seconds("retransmission_timeout", settings.retransmissionTimeout, 10ms, settings.sessionTimeout / 2);
  section.seconds("cache", settings.cache, 0ms, 60s);
}

[[noreturn]] void refuseSecret(const std::string& key, const std::string& path, const std::string& reason) {
  Settings(place, {}).refuse(key, path, reason);
}

std::string readSecret(const std::string& key, const std::string& path) try {
  const std::string content = Ground::readSecretFile(path);
  const std::string line = content.substr(0, content.find_first_of("\r\n"));
  if (line.empty()) {
    throw std::runtime_error("its first line must hold the secret");
  }
  return line;
} catch (const std::runtime_error& error) {
  refuseSecret(key, path, error.what());
}

// The bytes that pairs of hexadecimal digits stand for; nothing if the text is of another form or empty.
std::optional<std::string> parseHexadecimal(const std::string& digits) {
  if (digits.empty() || digits.size() % 2 != 0) {
    return std::nullopt;
  }
  std::string bytes;
  for (std::size_t position = 0; position < digits.size(); position += 2) {
    unsigned char byte = 0;
    const char* pair = digits.data() + position;
    const auto [rest, error] = std::from_chars(pair, pair + 2, byte, 16);
    if (error != std::errc() || rest != pair + 2) {
      return std::nullopt;
    }
    bytes.push_back(static_cast<char>(byte));
  }
  return bytes;
}

}  // namespace

IpmiSettings parseSettings(const BackEndSettings& section) {
  IpmiSettings settings;
  const Settings reader(place, section);
  using Connection = IpmiSettings::Connection;
  reader.choice<Connection>("connection", settings.connection,
                            {{"inband", Connection::InBand}, {"lan", Connection::Lan}});
  refuseForeignKeys(reader, section, settings.connection);
  if (settings.connection == Connection::Lan) {
    readLan(reader, settings);
  } else {
    reader.text("device", settings.device);
  }
  reader.take("channels", [&](const std::string& value) { settings.channels = parseChannels(value); });
  reader.choice<Ipv6Choice>(
      "ipv6", settings.ipv6,
      {{"off", Ipv6Choice::Off}, {"static", Ipv6Choice::Static}, {"dynamic", Ipv6Choice::Dynamic}});
  readTimes(reader, settings);
  // The processes that share the file need not share a working directory.
  reader.absolutePath("generation_file", settings.generationFile);
  return settings;
}

std::string readPassword(const IpmiSettings& settings) {
  const std::string password = readSecret("password_file", settings.passwordFile);
  if (password.size() > longestSecret) {
    refuseSecret("password_file", settings.passwordFile, "IPMI allows a password of at most 20 bytes");
  }
  return password;
}

std::string readKey(const IpmiSettings& settings) {
  if (settings.keyFile.empty()) {
    return {};
  }
  std::string key = readSecret("k_g_file", settings.keyFile);
  if (key.starts_with("0x")) {
    const auto bytes = parseHexadecimal(key.substr(2));
    if (!bytes) {
      refuseSecret("k_g_file", settings.keyFile, "after 0x there must be pairs of hexadecimal digits");
    }
    key = *bytes;
  }
  if (key.size() > longestSecret) {
    refuseSecret("k_g_file", settings.keyFile, "IPMI allows a key of at most 20 bytes");
  }
  return key;
}

}  // namespace QV::Ipmi
