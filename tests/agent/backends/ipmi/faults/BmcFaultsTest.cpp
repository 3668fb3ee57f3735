// SPDX-License-Identifier: Apache-2.0
// Every exchange between the back end and a BMC goes wrong once, in every way that it can, on a BMC that applies what
// is committed, one that does so at once, and one without a lock: which exchanges an operation has is found by running
// it. Afterwards the BMC has the old values or the new ones, its lock is free, its session given back, and the caller
// has learned in time and truly what came of it, and so has the log.
//
// By itself the test takes a fixed share of the points. With BMC_FAULTS=all it takes them all; with any other value,
// those whose names contain it.
#include <gmock/gmock.h>

#include <cstdlib>
#include <iostream>
#include <map>

#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "agent/backends/ipmi/lan/AddressPlan.h"
#include "agent/backends/ipmi/session/IpmiConnection.h"
#include "tests/agent/backends/ipmi/faults/CommandFaults.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/RecordingLog.h"
#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/agent/UdpRelay.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using namespace std::chrono_literals;
using QV::Ipmi::AddressSettings;
using QV::Ipmi::AddressSource;
using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::LanParameter;
using QV::Ipmi::NetworkFunction;
using QV::Ipmi::Repetition;
using Clock = std::chrono::steady_clock;
using Personality = SimulatedBmc::Personality;

constexpr std::uint8_t channel = 1;

// Small, so that what is lost is soon missed.
constexpr auto operationTimeout = 2000ms;
const std::map<std::string, std::string> timeouts = {
    {"operation_timeout", "2"}, {"session_timeout", "1"}, {"retransmission_timeout", "0.1"}};
constexpr auto tolerance = 500ms;

// A machine that stalls for longer than that does what no fault was to do: what comes out wrong counts if it does so
// each time.
constexpr int attempts = 3;

// What undisturbed requests get on a busy machine.
constexpr auto patience = 30s;

// Of all points, one in so many.
const unsigned share = sanitized() ? 53 : 11;

const std::string& chosen() {
  static const std::string choice = [] {
    const char* const text = std::getenv("BMC_FAULTS");
    return std::string(text ? text : "");
  }();
  return choice;
}

enum class Operation { Read, ChangeAddress, ChangeMask, ChangeBoth, ChangeBothFromDhcp };

const std::map<Operation, std::string> operations = {{Operation::Read, "read"},
                                                     {Operation::ChangeAddress, "change of the address"},
                                                     {Operation::ChangeMask, "change of the mask"},
                                                     {Operation::ChangeBoth, "change of both"},
                                                     {Operation::ChangeBothFromDhcp, "change of both from DHCP"}};

// What goes wrong with one exchange, and how.
struct Fault {
  std::string name;
  bool onWire;
  std::function<void(UdpRelay& wire, unsigned exchange)> strike;
};

std::string hexadecimal(unsigned number) {
  std::ostringstream text;
  text << "0x" << std::hex << std::uppercase << number;
  return text.str();
}

std::vector<Fault> commandFaults() {
  using Kind = CommandFault::Kind;
  std::vector<Fault> faults;
  const auto add = [&](const std::string& name, const CommandFault& fault) {
    faults.push_back({name, false, [fault](UdpRelay&, unsigned exchange) { disturbCommand(exchange, fault); }});
  };
  // IPMI 2.0, table 5-2, and the LAN configuration commands' own.
  std::vector<unsigned> codes = {0x80, 0x81, 0x82, 0xFF};
  for (unsigned code = 0xC0; code <= 0xD6; ++code) {
    codes.push_back(code);
  }
  for (const unsigned code : codes) {
    add("refused with " + hexadecimal(code), {Kind::Refused, static_cast<std::uint8_t>(code)});
  }
  add("lost before it was done", {Kind::LostBefore});
  add("lost after it was done", {Kind::LostAfter});
  add("cut to nothing", {Kind::CutToNothing});
  add("cut to its code", {Kind::CutToCode});
  add("cut by one byte", {Kind::CutByOne});
  return faults;
}

std::vector<Fault> wireFaults() {
  using Disturbance = UdpRelay::Disturbance;
  std::vector<Fault> faults;
  const std::map<Disturbance, std::string> names = {
      {Disturbance::RequestLost, "request lost"}, {Disturbance::RequestDoubled, "request doubled"},
      {Disturbance::RequestCut, "request cut"},   {Disturbance::AnswerLost, "answer lost"},
      {Disturbance::AnswerLate, "answer late"},   {Disturbance::AnswerDoubled, "answer doubled"},
      {Disturbance::AnswerCut, "answer cut"}};
  faults.reserve(names.size() + 2);
  for (const auto& [disturbance, name] : names) {
    faults.push_back({name, true, [disturbance = disturbance](UdpRelay& wire, unsigned exchange) {
                        wire.disturbRequest(exchange, disturbance);
                      }});
  }
  faults.push_back(
      {"silence from its answer on", true, [](UdpRelay& wire, unsigned exchange) { wire.cutAtRequest(exchange); }});
  faults.push_back({"done after everybody has left", true,
                    [](UdpRelay& wire, unsigned exchange) { wire.stallAtRequest(exchange); }});
  return faults;
}

// What the BMC has, as one sees it who is not disturbed.
struct Truth {
  AddressSettings settings;
  bool locked;
  unsigned sessions;  // this one included
};

class Witness {
 public:
  explicit Witness(QV::BackEndSettings section) : connection_(QV::Ipmi::parseSettings(patiently(section))) {}

  Truth look() {
    connection_.startOperation(QV::Ipmi::Deadline(patience));
    const auto lock = QV::Ipmi::getParameter(connection_, channel, LanParameter::SetInProgress);
    constexpr std::uint8_t getSessionInfo = 0x3D, presentSession = 0;
    const auto sessions =
        connection_.send({NetworkFunction::Application, getSessionInfo, {presentSession}}, Repetition::Allowed);
    return {QV::Ipmi::readAddressSettings(connection_, channel), lock.value().at(0) != 0, sessions.data.at(2)};
  }

  void write(const AddressSettings& settings) {
    connection_.startOperation(QV::Ipmi::Deadline(patience));
    const auto set = [&](LanParameter parameter, const QV::Ipmi::ParameterData& data) {
      QV::Ipmi::setParameter(connection_, channel, parameter, data, Repetition::Allowed);
    };
    set(LanParameter::SetInProgress, {1});
    set(LanParameter::AddressSource, {static_cast<std::uint8_t>(*settings.source)});
    set(LanParameter::IpAddress, QV::Ipmi::toData(*settings.address));
    set(LanParameter::SubnetMask, QV::Ipmi::toData(*settings.mask));
    set(LanParameter::SetInProgress, {2});
    set(LanParameter::SetInProgress, {0});
  }

 private:
  static QV::BackEndSettings& patiently(QV::BackEndSettings& section) {
    section["operation_timeout"] = "30";
    section["session_timeout"] = "20";
    return section;
  }

  QV::Ipmi::IpmiConnection connection_;
};

const AddressSettings plain{AddressSource::Static, QV::ipv4("192.0.2.10"), QV::mask("255.255.255.0")};
const AddressSettings other{AddressSource::Static, QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")};

std::string textOf(const AddressSettings& settings) {
  return (settings.address ? settings.address->text() : "none") + '/' +
         (settings.mask ? settings.mask->text() : "none") + " (source " +
         (settings.source ? std::to_string(static_cast<int>(*settings.source)) : "none") + ')';
}

class Bench {
 public:
  Bench(Personality personality, bool held, bool hasLock) : bmc_(personality), held_(held) {
    withoutLock(!hasLock);
    witness_.write(plain);
    sessions_ = witness_.look().sessions;
  }

  // How many exchanges the operation has where nothing goes wrong.
  struct Length {
    unsigned commands;
    unsigned datagrams;
  };
  Length measure(Operation operation) {
    const AddressSettings earlier = prepare(operation);
    disturbCommand(0, {});
    wire_.reset();
    attempt(operation, wantedAfter(operation, earlier));
    const Length length{commandsSent(), wire_.requests()};
    restore();
    return length;
  }

  // What is wrong after the fault, each time that it is tried; empty if nothing is.
  std::string run(Operation operation, const Fault& fault, unsigned exchange) {
    std::string wrong;
    for (int attempt = 0; attempt < attempts; ++attempt) {
      try {
        wrong = runOnce(operation, fault, exchange);
      } catch (const std::exception& error) {
        wrong = error.what();
      }
      if (wrong.empty()) {
        break;
      }
    }
    return wrong;
  }

  std::string summary() const {
    return std::to_string(done_) + " were done, " + std::to_string(failed_) + " failed, of " +
           std::to_string(unknown_) + " the outcome was unknown";
  }

 private:
  std::string runOnce(Operation operation, const Fault& fault, unsigned exchange) {
    const AddressSettings earlier = prepare(operation);
    const AddressSettings wanted = wantedAfter(operation, earlier);
    takeLog();
    fault.strike(wire_, exchange);
    const auto start = Clock::now();
    const std::string failure = attempt(operation, wanted);
    const auto taken = Clock::now() - start;
    undisturbCommands();
    wire_.undisturb();
    wire_.join();
    ++(failure.empty() ? done_ : failure.find("unknown") != std::string::npos ? unknown_ : failed_);

    std::string wrong;
    if (taken > operationTimeout + tolerance) {
      wrong += "; it took " + std::to_string(std::chrono::duration_cast<std::chrono::milliseconds>(taken).count()) +
               " milliseconds";
    }
    const std::string later = recover();
    if (!later.empty()) {
      wrong += "; a later read fails: " + later;
    }
    const auto log = takeLog();
    // An Open Session request that arrives twice makes a second session, which nobody knows of.
    constexpr unsigned openSession = 2;
    const bool openedTwice = fault.onWire && !held_ && exchange == openSession;
    const bool broken = openedTwice || contains(log, "Tarnwick.Ipmi", 4000, "stopped answering") ||
                        contains(log, "Tarnwick.Ipmi", 6000, "stopped answering") ||
                        contains(log, "Tarnwick.Ipmi", 6000, "did not open a session") ||
                        contains(log, "Tarnwick.Ipmi", 6000, "operation_timeout");
    wrong += judgeLog(operation, failure, log);
    restore();
    wrong += judge(operation, earlier, wanted, failure, broken);
    return wrong.empty() ? "" : wrong.substr(2) + (failure.empty() ? "" : " [" + failure + ']');
  }

  AddressSettings prepare(Operation operation) {
    AddressSettings earlier = witness_.look().settings;
    if (operation == Operation::ChangeBothFromDhcp) {
      earlier.source = AddressSource::Dhcp;
      witness_.write(earlier);
    } else if (earlier.source != AddressSource::Static) {
      earlier.source = AddressSource::Static;
      witness_.write(earlier);
    }
    if (!backEnd_) {
      auto settings = bmc_.settings(wire_.port());
      for (const auto& [key, value] : timeouts) {
        settings[key] = value;
      }
      backEnd_ = std::make_unique<IpmiBackEnd>(QV::Ipmi::parseSettings(settings));
    }
    if (held_) {
      recover();
    }
    return earlier;
  }

  static AddressSettings wantedAfter(Operation operation, const AddressSettings& earlier) {
    AddressSettings wanted = earlier;
    if (operation == Operation::Read) {
      return wanted;
    }
    wanted.source = AddressSource::Static;
    if (operation != Operation::ChangeMask) {
      wanted.address = earlier.address == plain.address ? other.address : plain.address;
    }
    if (operation != Operation::ChangeAddress) {
      wanted.mask = earlier.mask == plain.mask ? other.mask : plain.mask;
    }
    return wanted;
  }

  // The text of the failure, if it fails.
  std::string attempt(Operation operation, const AddressSettings& wanted) {
    shown_.reset();
    try {
      if (operation == Operation::Read) {
        shown_ = backEnd_->read().interfaces.at(0);
      } else {
        backEnd_->change("lan1", {operation == Operation::ChangeMask ? std::nullopt : wanted.address,
                                  operation == Operation::ChangeAddress ? std::nullopt : wanted.mask});
      }
      return {};
    } catch (const std::exception& error) {
      return error.what();
    }
  }

  // What a client does that goes on: it asks again, until the BMC answers.
  std::string recover() {
    const auto deadline = Clock::now() + patience;
    for (;;) {
      try {
        backEnd_->read();
        return {};
      } catch (const std::exception& error) {
        if (Clock::now() > deadline) {
          return error.what();
        }
      }
    }
  }

  void restore() {
    if (!held_) {
      backEnd_.reset();
    }
  }

  static std::string judgeLog(Operation operation, const std::string& failure, const std::vector<LogLine>& log) {
    if (!failure.empty()) {
      return contains(log, "Tarnwick.Ipmi", 6000, failure) ? "" : "; the log does not say why it failed";
    }
    return operation == Operation::Read || contains(log, "Tarnwick.Ipmi", 4000, "done and confirmed")
               ? ""
               : "; the log does not say that it was done";
  }

  std::string judge(Operation operation, const AddressSettings& earlier, const AddressSettings& wanted,
                    const std::string& failure, bool broken) {
    const auto says = [&](const char* text) { return failure.find(text) != std::string::npos; };
    const Truth truth = witness_.look();
    std::string wrong;
    if (truth.locked) {
      wrong += "; the lock is left behind";
      witness_.write(truth.settings);
    }
    const bool old = truth.settings == earlier;
    const bool changed = truth.settings == wanted;
    if (!old && !changed) {
      wrong += "; the BMC has " + textOf(truth.settings) + ", neither " + textOf(earlier) + " nor " + textOf(wanted);
      witness_.write(plain);
    } else if (failure.empty() && !changed) {
      wrong += "; the caller takes it for done, and it is not";
    } else if ((says("nothing was changed") || says("earlier values hold") || says("put back")) && !old) {
      wrong += "; the caller takes the earlier values to hold, and they do not";
    } else if (says("could not be put back")) {
      wrong += "; the earlier values could not be put back";
    }
    if (operation != Operation::Read && !failure.empty() && !says("nothing was changed") && !says("earlier values") &&
        !says("unknown")) {
      wrong += "; the caller is left to guess what holds";
    }
    if (shown_ && ((shown_->ipv4Address && shown_->ipv4Address != truth.settings.address) ||
                   (shown_->ipv4SubnetMask && shown_->ipv4SubnetMask != truth.settings.mask))) {
      wrong += "; the read showed other values than the BMC has";
    }
    // Nor can a session that broke be given back. The BMC ends either by itself, in a minute.
    const unsigned expected = sessions_ + (held_ ? 1 : 0);
    if (truth.sessions > expected && !broken) {
      wrong += "; a session is left behind";
    }
    sessions_ = truth.sessions - (held_ ? 1 : 0);
    return wrong;
  }

  const SimulatedBmc bmc_;
  const bool held_;
  UdpRelay wire_{bmc_.port()};
  Witness witness_{bmc_.settings()};
  std::unique_ptr<IpmiBackEnd> backEnd_;
  std::optional<QV::NetworkInterface> shown_;
  unsigned sessions_ = 0;
  unsigned done_ = 0, failed_ = 0, unknown_ = 0;
};

struct Ground {
  Personality personality;
  bool hasLock;
  bool held;
  bool onWire;

  std::string name() const {
    return std::string(personality == Personality::AppliesOnCommit ? "OnCommit" : "AtOnce") +
           (hasLock ? "" : "WithoutLock") + (held ? "Held" : "Cold") + (onWire ? "Wire" : "Command");
  }
};

class BmcFaultsTest : public testing::TestWithParam<Ground> {};

TEST_P(BmcFaultsTest, LeaveTheOldValuesOrTheNewAndNoLockAndNoSession) {
  auto faults = GetParam().onWire ? wireFaults() : commandFaults();
  if (GetParam().onWire && !GetParam().hasLock) {
    faults.resize(faults.size() - 2);  // whoever applies at once and falls silent stays as he is
  }
  Bench bench(GetParam().personality, GetParam().held, GetParam().hasLock);
  unsigned points = 0;
  unsigned tried = 0;
  unsigned wrong = 0;
  for (const auto& [operation, operationName] : operations) {
    const auto length = bench.measure(operation);
    for (unsigned exchange = 1; exchange <= (GetParam().onWire ? length.datagrams : length.commands); ++exchange) {
      for (const Fault& fault : faults) {
        const std::string name =
            GetParam().name() + ", " + operationName + ", exchange " + std::to_string(exchange) + ", " + fault.name;
        ++points;
        if (chosen().empty() ? points % share != 0 : chosen() != "all" && name.find(chosen()) == std::string::npos) {
          continue;
        }
        ++tried;
        const std::string what = bench.run(operation, fault, exchange);
        EXPECT_EQ(what, "") << name;
        wrong += what.empty() ? 0 : 1;
      }
    }
  }
  std::cout << GetParam().name() << ": " << tried << " of " << points << " points, " << wrong
            << " of them wrong; of the operations " << bench.summary() << std::endl;
}

std::vector<Ground> grounds() {
  std::vector<Ground> all;
  for (const bool held : {false, true}) {
    for (const bool onWire : {false, true}) {
      all.push_back({Personality::AppliesOnCommit, true, held, onWire});
      all.push_back({Personality::AppliesAtOnce, true, held, onWire});
      all.push_back({Personality::AppliesAtOnce, false, held, onWire});
    }
  }
  return all;
}

INSTANTIATE_TEST_SUITE_P(Grounds, BmcFaultsTest, testing::ValuesIn(grounds()),
                         [](const auto& ground) { return ground.param.name(); });

}  // namespace
