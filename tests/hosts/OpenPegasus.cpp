#include "tests/hosts/OpenPegasus.h"

#include "tests/support/system/Poll.h"

namespace Testing {
namespace {

constexpr const char* modules[] = {"compositeipconfigprovider", "underlyingipconfigprovider"};

}  // namespace

std::vector<std::string> OpenPegasus::parts() const {
  return {"bin/cimserver", "bin/cimconfig", "bin/cimmof", "bin/cimprovider", "bin/cimcli", "repository/root#cimv2"};
}

std::vector<std::string> OpenPegasus::programs() const {
  return {prefix() + "/bin/cimserver", prefix() + "/bin/cimprovagt"};
}

Environment OpenPegasus::environment() const {
  Environment environment = ObjectManager::environment();
  environment["PEGASUS_HOME"] = prefix();
  environment["LD_LIBRARY_PATH"] = prefix() + "/lib";
  return environment;
}

void OpenPegasus::prepare() {
  // What a server that runs on this machine keeps there is not ours.
  run("rm -f /var/tmp/cimxml.socket /var/tmp/cimserver_start.*\n"
      "cimconfig -s enableHttpsConnection=false -p\n"
      "cimconfig -s listenAddress=127.0.0.1 -p\n"
      "cimconfig -s httpPort=" +
      std::to_string(port()) + " -p");
}

std::vector<std::string> OpenPegasus::installing() const {
  return {"install",           "configure",           "OpenPegasus listen", "OpenPegasus providers",
          "OpenPegasus start", "OpenPegasus register"};
}

std::vector<std::string> OpenPegasus::removing() const {
  return {"OpenPegasus remove", "OpenPegasus stop", "OpenPegasus forget", "uninstall"};
}

std::vector<std::string> OpenPegasus::upgrading() const {
  return {"OpenPegasus stop", "install", "OpenPegasus start", "OpenPegasus upgrade"};
}

std::vector<std::string> OpenPegasus::registeringByCommand() const {
  return {"OpenPegasus start", "OpenPegasus command register"};
}

std::vector<std::string> OpenPegasus::takingOutByCommand() const {
  return {"OpenPegasus command remove", "OpenPegasus stop"};
}

bool OpenPegasus::unloadProviders() {
  for (const char* module : modules) {
    run(std::string("cimprovider -d -m ") + module);
  }
  return poll([] { return providerProcesses().empty(); });
}

void OpenPegasus::allowProviders() {
  for (const char* module : modules) {
    run(std::string("cimprovider -e -m ") + module);
  }
}

}  // namespace Testing
