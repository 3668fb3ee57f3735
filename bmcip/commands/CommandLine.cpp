// SPDX-License-Identifier: Apache-2.0
#include <CLI/CLI.hpp>

#include "bmcip/commands/Configuration.h"
#include "bmcip/commands/Options.h"
#include "bmcip/model/Change.h"

namespace Bmcip {
namespace {

constexpr const char* description =
    "Shows and changes the IP configuration of a server's management processor, through the CIM object manager that\n"
    "serves it.";

constexpr const char* examples = R"(Examples:
  bmcip show                            the management processor of this machine
  bmcip show --hosts servers.txt        of many servers, one a line
  bmcip show --json web1 web2 | jq -r '.interfaces[].address'
  bmcip set eth0 192.0.2.77/25          another address and mask, read back
  bmcip set eth0 192.0.2.77/25 --dry-run
  bmcip model --svg model.svg           what is associated with what
  bmcip watch                           changes as they come
bmcip --help has the options of all commands; the manual page, bmcip(1), the exit statuses and the configuration file.)";

// The command line as it was given, before its values are looked at.
struct Given {
  GivenSettings settings;
  std::string configurationFile;
  std::string user;
  std::string wanted;
  std::string address;
  std::string wait;
  std::string interval;
};

void declareCommonOptions(CLI::App& app, Options& options, Given& given) {
  app.add_option("--config", given.configurationFile,
                 "configuration file, in place of ~/.config/bmcip.ini or " + systemConfigurationFile())
      ->type_name("FILE");
  for (const Setting& setting : settings()) {
    const std::string option = std::string("--") + setting.name;
    std::string& value = given.settings[setting.name];
    if (setting.isSwitch) {
      app.add_flag_function(
          option, [&value](std::int64_t) { value = "yes"; }, setting.help);
    } else {
      app.add_option(option, value, setting.help)->type_name(setting.valueName);
    }
  }
  app.add_option("--user", given.user, "log in with this name; the password is asked for at the terminal")
      ->type_name("NAME");
  app.add_flag("--json", options.json, "JSON, one object a line (bmcip.schema.json has it)");
}

void declareShow(CLI::App& app, Options& options) {
  CLI::App* show = app.add_subcommand("show", "the computer system, interfaces, gateways and DNS servers");
  show->add_option("hosts", options.hosts, "[SCHEME://]HOST[:PORT][/NAMESPACE]; the rest is that of --url")
      ->type_name("HOST");
  show->add_option("--hosts", options.hostsFile, "ask the servers of this file, one a line; - is the standard input")
      ->type_name("FILE");
  show->callback([&options] { options.command = Command::Show; });
}

void declareSet(CLI::App& app, Options& options, Given& given) {
  CLI::App* set = app.add_subcommand("set", "change address and mask, and read back until they are there");
  set->add_option("interface", options.interface, "the interface, as show names it")
      ->type_name("INTERFACE")
      ->required();
  CLI::Option* wanted = set->add_option("wanted", given.wanted, "address and length of the prefix: 192.0.2.77/25")
                            ->type_name("ADDRESS[/LENGTH]");
  set->add_option("--address", given.address, "the address alone")->type_name("ADDRESS")->excludes(wanted);
  set->add_option("--mask", options.newMask, "the subnet mask: 255.255.255.128")->type_name("MASK");
  set->add_flag("--dry-run", options.dryRun, "show what would be sent, and send nothing");
  set->add_flag("--yes", options.yes, "ask nothing, also where the change cuts this very connection");
  set->add_option("--wait", given.wait, "how long to wait for the change to show (10)")->type_name("SECONDS");
  set->callback([&options] { options.command = Command::Set; });
}

void declareWatch(CLI::App& app, Options& options, Given& given) {
  CLI::App* watch = app.add_subcommand("watch", "changes as they come, until it is interrupted");
  watch->add_option("--interval", given.interval, "how often to look (2)")->type_name("SECONDS");
  watch->callback([&options] { options.command = Command::Watch; });
}

void declareModel(CLI::App& app, Options& options) {
  CLI::App* model = app.add_subcommand("model", "what is associated with what, as a tree");
  model->add_option("--svg", options.svgFile, "draw it into this file instead; - is the standard output")
      ->type_name("FILE");
  model->callback([&options] { options.command = Command::Model; });
}

void takeSeconds(const char* option, const std::string& text, std::chrono::milliseconds least,
                 std::chrono::milliseconds& target) {
  if (text.empty()) {
    return;
  }
  try {
    target = Ground::parseSeconds(text, least, std::chrono::hours(24));
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(std::string(option) + ": " + refusal.what() + ", not \"" + text + "\"");
  }
}

void takeWanted(const Given& given, Options& options) {
  options.newAddress = given.address;
  if (!given.wanted.empty()) {
    const Ipv4Settings wanted = parseAddressWithPrefix(given.wanted);
    if (!wanted.mask.empty() && !options.newMask.empty()) {
      throw UsageError("the mask is given twice: by the length of the prefix and by --mask");
    }
    options.newAddress = wanted.address;
    options.newMask = wanted.mask.empty() ? options.newMask : wanted.mask;
  }
  if (options.newAddress.empty() && options.newMask.empty()) {
    throw UsageError("set needs an address, 192.0.2.77/25, or --address or --mask");
  }
}

void take(const Given& given, Options& options) {
  applySettings(options, given.settings, given.configurationFile);
  takeSeconds("--wait", given.wait, std::chrono::milliseconds(0), options.wait);
  takeSeconds("--interval", given.interval, std::chrono::milliseconds(100), options.interval);
  if (!given.user.empty()) {
    options.access.user = given.user;
    options.access.password.clear();
    options.access.netrc = false;
    options.askPassword = true;
  }
  if (options.command == Command::Set) {
    takeWanted(given, options);
  }
}

}  // namespace

std::optional<Options> readCommandLine(int argc, const char* const* argv) {
  Options options;
  Given given;
  CLI::App app(description, "bmcip");
  app.set_help_flag();
  app.set_help_all_flag("-h,--help", "this text");
  app.set_version_flag("--version", "bmcip " BMCIP_VERSION);
  app.require_subcommand(1);
  app.fallthrough();
  app.footer(examples);
  declareCommonOptions(app, options, given);
  declareShow(app, options);
  declareSet(app, options, given);
  declareWatch(app, options, given);
  declareModel(app, options);
  try {
    app.parse(argc, argv);
    take(given, options);
  } catch (const CLI::Success& asked) {
    app.exit(asked);
    return std::nullopt;
  } catch (const CLI::ParseError& error) {
    throw UsageError(std::string(error.what()) + " (bmcip --help shows the options)");
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(refusal.what());
  }
  return options;
}

}  // namespace Bmcip
