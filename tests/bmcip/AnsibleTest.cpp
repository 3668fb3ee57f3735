// SPDX-License-Identifier: Apache-2.0
// The Ansible role, with Debian's ansible-core against several servers of this machine.
#include <gmock/gmock.h>

#include <array>
#include <filesystem>
#include <memory>

#include "Paths.h"
#include "tests/bmcip/BmcipTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;

constexpr const char* playbook = R"(
- hosts: all
  gather_facts: false
  roles:
    - role: bmcip
      vars:
        bmcip_interfaces: "{{ wanted | default([{'name': 'eth0', 'address': own_address, 'mask': '255.255.255.128'}]) }}"
  post_tasks:
    - ansible.builtin.debug:
        msg: "fact {{ inventory_hostname }} {{ ansible_local.bmcip.interfaces[0].address | default('none') }}"
      when: not ansible_check_mode
)";

class BmcipAnsibleTest : public BmcipTest {
 protected:
  void SetUp() override {
    if (run({"sh", "-c", "command -v ansible-playbook"}).status != 0) {
      GTEST_SKIP() << "ansible-playbook (ansible-core) is not there";
    }
    std::string inventory;
    for (std::size_t i = 0; i < servers_.size(); ++i) {
      const std::string number = std::to_string(i);
      servers_[i] = std::make_unique<CompositeStack>(simulatedProcessor(stateOf(i)));
      inventory += "server" + number +
                   " ansible_connection=local bmcip_url=http://127.0.0.1:" + std::to_string(servers_[i]->port()) +
                   " bmcip_facts_directory=" + (directory_ / ("facts" + number)) + " own_address=192.0.2.7" + number +
                   "\n";
    }
    directory_.write("inventory", inventory + "[all:vars]\nansible_python_interpreter=/usr/bin/python3\n" +
                                      "bmcip_command=" + built("bin/bmcip") + "\nbmcip_wait=1\n");
    directory_.write("playbook.yml", playbook);
  }

  std::string stateOf(std::size_t server) const {
    return directory_ / ("processor" + std::to_string(server) + ".json");
  }

  Completed play(const std::vector<std::string>& more = {}) const {
    std::vector<std::string> command = {"ansible-playbook", "-i", directory_ / "inventory",
                                        directory_ / "playbook.yml"};
    command.insert(command.end(), more.begin(), more.end());
    return run(command, {{"HOME", directory_.path().string()},
                         {"ANSIBLE_ROLES_PATH", SOURCE_DIR "/ansible/roles"},
                         {"ANSIBLE_NOCOLOR", "1"},
                         {"LC_ALL", "C.UTF-8"}});
  }

  std::string addressOf(std::size_t server) const { return servers_[server]->get(endpoint("eth0")).at("IPv4Address"); }

  std::array<std::unique_ptr<CompositeStack>, 3> servers_;
};

TEST_F(BmcipAnsibleTest, ChangesOnceAndSaysSoInCheckModeToo) {
  const Completed checked = play({"--check"});
  EXPECT_EQ(checked.status, 0) << checked.output << checked.errors;
  EXPECT_THAT(checked.output, HasSubstr("changed: [server1] => (item=eth0)"));
  EXPECT_EQ(addressOf(1), quoted("192.0.2.10"));

  const Completed changed = play();
  EXPECT_EQ(changed.status, 0) << changed.output << changed.errors;
  for (std::size_t i = 0; i < servers_.size(); ++i) {
    const std::string number = std::to_string(i);
    EXPECT_THAT(changed.output, AllOf(HasSubstr("changed: [server" + number + "] => (item=eth0)"),
                                      HasSubstr("fact server" + number + " 192.0.2.7" + number)));
    EXPECT_EQ(addressOf(i), quoted("192.0.2.7" + number));
  }

  const Completed again = play();
  EXPECT_EQ(again.status, 0) << again.output << again.errors;
  EXPECT_THAT(again.output, ContainsRegex("server2 +: ok=5 +changed=0 +unreachable=0 +failed=0 "));
}

TEST_F(BmcipAnsibleTest, FailsWhereTheProcessorDoesNotTakeIt) {
  servers_[1]->paths("ein", "YRNx_MgmtHwIPProtocolEndPoint");
  std::filesystem::remove(stateOf(1) + ".lock");
  std::filesystem::create_directory(stateOf(1) + ".lock");
  const Completed failed = play();
  EXPECT_NE(failed.status, 0);
  EXPECT_THAT(failed.output, AllOf(HasSubstr("failed: [server1] (item=eth0)"), HasSubstr("not applied: "),
                                   HasSubstr("changed: [server2] => (item=eth0)")));
}

TEST_F(BmcipAnsibleTest, FailsOnAMistake) {
  const Completed failed = play({"-e", R"({"wanted": [{"name": "eth0", "address": "127.0.0.1"}]})"});
  EXPECT_NE(failed.status, 0);
  EXPECT_THAT(failed.output, HasSubstr("is a loopback address"));
}

}  // namespace
