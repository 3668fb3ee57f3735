#include "agent/backends/ipmi/settings/IpmiSettings.h"

#include <algorithm>
#include <set>
#include <stdexcept>

#include "agent/backends/ipmi/settings/SecretFile.h"
#include "agent/backends/ipmi/settings/SettingValues.h"
#include "agent/backends/ipmi/settings/Workarounds.h"

namespace QV::Ipmi {
namespace {

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

void refuseForeignKeys(const BackEndSettings& section, IpmiSettings::Connection connection) {
  const bool lan = connection == IpmiSettings::Connection::Lan;
  for (const auto& [key, value] : section) {
    if (commonKeys.contains(key) || (lan ? lanKeys : inBandKeys).contains(key)) continue;
    if ((lan ? inBandKeys : lanKeys).contains(key))
      refuseValue(key, value, std::string("the key belongs to connection = ") + (lan ? "inband" : "lan"));
    refuseValue(key, value, "there is no such key");
  }
}

ChannelChoice parseChannels(const std::string& key, const std::string& value) {
  if (value == "auto") return {ChannelChoice::Mode::InUse, {}};
  if (value == "all") return {ChannelChoice::Mode::All, {}};
  std::set<std::uint8_t> channels;
  for (const std::string& word : splitList(key, value))
    channels.insert(static_cast<std::uint8_t>(parseNumber(key, word, 1, 11)));
  return {ChannelChoice::Mode::Listed, {channels.begin(), channels.end()}};
}

void readLan(SettingReader& reader, IpmiSettings& settings) {
  settings.host = reader.required("host");
  reader.number("port", settings.port, 1, 65535);
  settings.user = reader.required("user");
  if (settings.user.size() > longestUser) refuseValue("user", settings.user, "IPMI allows at most 16 bytes");
  settings.passwordFile = reader.required("password_file");
  reader.text("k_g_file", settings.keyFile);
  reader.number("cipher_suite", settings.cipherSuite, 0, 255);
  if (!soundCipherSuites.contains(settings.cipherSuite))
    refuseValue("cipher_suite", std::to_string(settings.cipherSuite),
                "only 3, 8, 12 and 17 authenticate, protect and encrypt");
  reader.choice<std::uint8_t>("privilege", settings.privilege, {{"user", 2}, {"operator", 3}, {"admin", 4}});
  if (const std::string* value = reader.find("workarounds"))
    for (const std::string& name : splitList("workarounds", *value)) settings.workarounds |= workaroundFlag(name);
  readPassword(settings);
  readKey(settings);
}

void readTimes(SettingReader& reader, IpmiSettings& settings) {
  using namespace std::chrono_literals;
  reader.seconds("operation_timeout", settings.operationTimeout, 100ms, 60s);
  // libfreeipmi sees that the session time-out is over up to two retransmissions late. These defaults leave the time to
  // say why no session opens before the operation's own is over.
  settings.sessionTimeout = settings.operationTimeout * 3 / 5;
  reader.seconds("session_timeout", settings.sessionTimeout, 40ms, settings.operationTimeout);
  settings.retransmissionTimeout = std::min(settings.retransmissionTimeout, settings.sessionTimeout / 6);
  reader.seconds("retransmission_timeout", settings.retransmissionTimeout, 10ms, settings.sessionTimeout / 2);
  reader.seconds("cache", settings.cache, 0ms, 60s);
}

// The processes that share the file need not share a working directory.
void readGenerationFile(SettingReader& reader, IpmiSettings& settings) {
  reader.text("generation_file", settings.generationFile);
  if (!settings.generationFile.starts_with('/')) {
    refuseValue("generation_file", settings.generationFile, "must be an absolute path");
  }
}

std::string readShortSecret(const std::string& key, const std::string& path) {
  try {
    return readSecretFile(path);
  } catch (const std::runtime_error& error) {
    refuseValue(key, path, error.what());
  }
}

}  // namespace

IpmiSettings parseSettings(const BackEndSettings& section) {
  IpmiSettings settings;
  SettingReader reader(section);
  using Connection = IpmiSettings::Connection;
  reader.choice("connection", settings.connection, {{"inband", Connection::InBand}, {"lan", Connection::Lan}});
  refuseForeignKeys(section, settings.connection);
  if (settings.connection == Connection::Lan)
    readLan(reader, settings);
  else
    reader.text("device", settings.device);
  if (const std::string* value = reader.find("channels")) settings.channels = parseChannels("channels", *value);
  reader.choice("ipv6", settings.ipv6,
                {{"off", Ipv6Choice::Off}, {"static", Ipv6Choice::Static}, {"dynamic", Ipv6Choice::Dynamic}});
  readTimes(reader, settings);
  readGenerationFile(reader, settings);
  return settings;
}

std::string readPassword(const IpmiSettings& settings) {
  const std::string password = readShortSecret("password_file", settings.passwordFile);
  if (password.size() > longestSecret)
    refuseValue("password_file", settings.passwordFile, "IPMI allows a password of at most 20 bytes");
  return password;
}

std::string readKey(const IpmiSettings& settings) {
  if (settings.keyFile.empty()) return {};
  std::string key = readShortSecret("k_g_file", settings.keyFile);
  if (key.starts_with("0x")) {
    const auto bytes = parseHexadecimal(key.substr(2));
    if (!bytes) refuseValue("k_g_file", settings.keyFile, "after 0x there must be pairs of hexadecimal digits");
    key = *bytes;
  }
  if (key.size() > longestSecret) refuseValue("k_g_file", settings.keyFile, "IPMI allows a key of at most 20 bytes");
  return key;
}

}  // namespace QV::Ipmi
