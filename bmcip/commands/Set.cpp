// SPDX-License-Identifier: Apache-2.0
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <iostream>
#include <thread>

#include "bmcip/commands/Commands.h"
#include "bmcip/commands/Terminal.h"
#include "bmcip/model/Vocabulary.h"
#include "bmcip/output/Json.h"
#include "bmcip/output/Tables.h"

namespace Bmcip {
namespace {

using Clock = std::chrono::steady_clock;

constexpr auto pause = std::chrono::milliseconds(250);

std::string whereTheReasonIs(const Server& server) {
  return "the reason is in the log of the management agent on " + server.host +
         ": syslog or journalctl, or the file that [log] of its agent.ini names";
}

Change planned(const Reading& reading, const Options& options) {
  const Interface* interface = reading.processor.findInterface(options.interface);
  if (!interface) {
    std::string names;
    for (const Interface& known : reading.processor.interfaces) {
      names += (names.empty() ? "" : ", ") + known.name;
    }
    throw UsageError("there is no interface " + options.interface + ": " +
                     (names.empty() ? "the management processor shows none" : "it must be one of " + names));
  }
  try {
    return planChange(*interface, options.newAddress, options.newMask);
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(refusal.what());
  }
}

// One change of one interface, from what was read before to what shows after.
class Setter {
 public:
  Setter(Transport& transport, const Options& options, const Reading& before)
      : transport_(transport), options_(options), server_(before.server), peer_(before.peer) {
    report_.server = before.server;
    report_.change = planned(before, options);
  }

  ChangeReport run() {
    if (!report_.change.isNeeded()) {
      report_.after = report_.change.before;
      return conclude(Outcome::Unchanged, "nothing to do: " + report_.change.interface + " has these values already");
    }
    if (options_.dryRun) {
      report_.after = report_.change.before;
      return conclude(Outcome::WouldChange, "nothing was sent: --dry-run");
    }
    if (cutsConnection() && !options_.yes &&
        !isConfirmed(harmless("The server was reached at " + peer_ + ", the address of " + report_.change.interface +
                              ": the change cuts this connection. Change it?"))) {
      return conclude(Outcome::NotConfirmed, "nothing was sent: the server was reached at " + peer_ +
                                                 ", the address of " + report_.change.interface +
                                                 ", and the change would cut the connection; --yes answers yes");
    }
    send();
    lookUntilShown();
    return judged();
  }

 private:
  bool cutsConnection() const {
    const Change& change = report_.change;
    return change.before.address == peer_ && change.wanted.address != peer_;
  }

  void send() {
    const Change& change = report_.change;
    const Call call = modifyInstance(server_.nameSpace, change.path, change.values());
    try {
      readNothing(transport_.ask(server_, call).message);
    } catch (const Failure& failure) {
      answer_ = failure.what();
      // A request without an answer may have been carried out all the same.
      isRefused_ = failure.kind() == FailureKind::Error || failure.kind() == FailureKind::Login ||
                   failure.kind() == FailureKind::NotServed;
    }
    if (cutsConnection()) {
      server_.host = change.wanted.address;
    }
  }

  // The last look counts: one that failed says that nobody knows.
  void lookUntilShown() {
    const auto end = Clock::now() + (isRefused_ ? std::chrono::milliseconds(0) : options_.wait);
    for (;;) {
      look();
      if ((report_.after && report_.change.isShownBy(*report_.after)) || Clock::now() >= end) {
        return;
      }
      std::this_thread::sleep_for(std::min<Clock::duration>(pause, end - Clock::now()));
    }
  }

  void look() {
    report_.after.reset();
    try {
      const Reading reading = readProcessor(transport_, server_);
      if (const Interface* interface = reading.processor.findInterface(report_.change.interface)) {
        report_.after = settingsOf(*interface);
        return;
      }
      lookFailure_ = "the management processor no longer shows the interface";
    } catch (const Failure& failure) {
      lookFailure_ = failure.what();
    }
  }

  ChangeReport judged() {
    const Outcome outcome = judge(report_.change, report_.after, isRefused_);
    const std::string answered = answer_.empty() ? "" : " (" + answer_ + ")";
    switch (outcome) {
      case Outcome::Applied:
        return conclude(outcome, "applied: the management processor shows the new values");
      case Outcome::Refused:
        return conclude(outcome, "refused: the object manager did not take the change" + answered + "; " +
                                     whereTheReasonIs(server_));
      case Outcome::HalfApplied:
        return conclude(outcome,
                        "half applied: the management processor shows neither the values from before nor all "
                        "of the new ones" +
                            answered + "; " + whereTheReasonIs(server_));
      case Outcome::Ignored:
        return conclude(outcome, "not applied: the object manager accepted the change" + answered +
                                     ", and the management processor still shows the values from before; " +
                                     whereTheReasonIs(server_));
      default:
        return conclude(Outcome::Unknown, "unknown: the change was sent" + answered +
                                              ", and what the management processor has now cannot be read: " +
                                              lookFailure_ + "; look again with bmcip show before anything else");
    }
  }

  ChangeReport conclude(Outcome outcome, const std::string& message) {
    report_.outcome = outcome;
    report_.message = message;
    return std::move(report_);
  }

  Transport& transport_;
  const Options& options_;
  Server server_;
  const std::string peer_;
  ChangeReport report_;
  std::string answer_;  // what came instead of an answer, or the error that was answered
  bool isRefused_ = false;
  std::string lookFailure_;
};

void print(const ChangeReport& report, const Options& options) {
  if (options.json) {
    std::cout << jsonOf(report) << std::endl;
    return;
  }
  std::cout << tableOf(report, Colours::of(STDOUT_FILENO));
  if (report.outcome == Outcome::WouldChange) {
    const Call call = modifyInstance(options.server.nameSpace, report.change.path, report.change.values());
    std::cout << "ModifyInstance to " << report.server.url() << ":\n" << call.message << '\n';
  }
  // What is not there is told where errors are read.
  std::ostream& stream = exitStatusOf(report.outcome) == 0 ? std::cout : std::cerr;
  std::cout << std::flush;
  stream << (exitStatusOf(report.outcome) == 0 ? "" : "bmcip: ") << harmless(report.message) << std::endl;
}

}  // namespace

int set(Transport& transport, const Options& options) {
  // Values that no interface can have are refused before anything is asked.
  try {
    planChange({}, options.newAddress, options.newMask);
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(refusal.what());
  }
  const ChangeReport report = Setter(transport, options, readProcessor(transport, options.server)).run();
  print(report, options);
  return exitStatusOf(report.outcome);
}

}  // namespace Bmcip
