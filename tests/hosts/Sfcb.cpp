#include "tests/hosts/Sfcb.h"

#include <filesystem>

#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

// Seconds that a provider may be idle, and how often that is looked at.
constexpr const char* impatience = "providerTimeoutInterval: 2\nproviderSampleInterval: 1\n";

}  // namespace

std::vector<std::string> Sfcb::parts() const {
  return {"sbin/sfcbd", "bin/sfcbstage", "bin/sfcbunstage", "bin/sfcbrepos", "share/sfcb/CIM/CIM_Schema.mof"};
}

std::vector<std::string> Sfcb::programs() const { return {prefix() + "/sbin/sfcbd"}; }

// A distribution's package keeps its configuration in /etc, an installation of its own below its prefix.
std::string Sfcb::configuration() const {
  const std::string own = prefix() + "/etc/sfcb/sfcb.cfg";
  return std::filesystem::exists(own) ? own : "/etc/sfcb/sfcb.cfg";
}

std::map<std::string, std::string> Sfcb::differences() const {
  std::map<std::string, std::string> differences = ObjectManager::differences();
  differences["/etc/sfcb/sfcb.cfg"] = configuration();
  return differences;
}

std::string Sfcb::diagnostics() const { return log() + readFile("/var/log/sfcbd.log"); }

void Sfcb::prepare() {
  run("sed -i -e 's/^httpPort:.*/httpPort: " + std::to_string(port()) + "/' -e '/^#*httpLocalOnly:/d' " +
      configuration() + "\necho 'httpLocalOnly: true' >> " + configuration());
}

std::vector<std::string> Sfcb::installing() const {
  return {"install", "configure", "sfcb providers", "sfcb register", "sfcb start"};
}

std::vector<std::string> Sfcb::removing() const { return {"sfcb stop", "sfcb remove", "uninstall"}; }

std::vector<std::string> Sfcb::upgrading() const { return {"sfcb stop", "install", "sfcb register", "sfcb start"}; }

std::vector<std::string> Sfcb::registeringByCommand() const { return {"sfcb command register", "sfcb start"}; }

std::vector<std::string> Sfcb::takingOutByCommand() const { return {"sfcb stop", "sfcb command remove"}; }

bool Sfcb::unloadProviders() {
  stop();
  run("cp -p " + configuration() + " /tmp/sfcb.cfg.patient\ncat >> " + configuration() + " <<'CFG'\n" + impatience +
      "CFG");
  start();
  names("ein", "YRNx_MgmtHwComputerSystem");
  return !providerProcesses().empty() && poll([] { return providerProcesses().empty(); });
}

void Sfcb::allowProviders() {
  stop();
  run("cp -p /tmp/sfcb.cfg.patient " + configuration());
  start();
}

}  // namespace Testing
