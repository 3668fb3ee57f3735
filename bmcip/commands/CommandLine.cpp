// SPDX-License-Identifier: Apache-2.0
#include <CLI/CLI.hpp>
#include <filesystem>
#include <map>

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
The manual page, bmcip(1), has the exit statuses and the configuration file.)";

// One way to write "so many seconds" for all options.
CLI::Option* addSetting(CLI::App& app, GivenSettings& given, const Setting& setting) {
  return app
      .add_option_function<std::string>(
          std::string("--") + setting.name,
          [&given, &setting](const std::string& value) { given[setting.name] = value; }, setting.help)
      ->type_name(setting.valueName);
}

std::chrono::milliseconds secondsOf(const std::string& option, const std::string& text,
                                    std::chrono::milliseconds least) {
  try {
    return Ground::parseSeconds(text, least, std::chrono::hours(24));
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(option + ": " + refusal.what() + ", not \"" + text + "\"");
  }
}

}  // namespace

std::optional<Options> readCommandLine(int argc, const char* const* argv) {
  Options options;
  GivenSettings given;
  std::string configurationFile;
  std::string user;
  std::string wait;
  std::string interval;
  std::string address;
  std::string newAddress;

  CLI::App app(description, "bmcip");
  app.set_help_flag();
  app.set_help_all_flag("-h,--help", "this text");
  app.set_version_flag("--version", "bmcip " BMCIP_VERSION);
  app.require_subcommand(1);
  app.fallthrough();
  app.footer(examples);

  app.add_option("--config", configurationFile,
                 "configuration file, in place of ~/.config/bmcip.ini or " + systemConfigurationFile())
      ->type_name("FILE");
  for (const Setting& setting : settings()) {
    if (setting.isSwitch) {
      app.add_flag_function(
          std::string("--") + setting.name, [&given, &setting](std::int64_t) { given[setting.name] = "yes"; },
          setting.help);
    } else {
      addSetting(app, given, setting);
    }
  }
  app.add_option("--user", user, "log in with this name; the password is asked for at the terminal")->type_name("NAME");
  app.add_flag("--json", options.json, "JSON, one object a line (bmcip.schema.json has it)");

  CLI::App* show = app.add_subcommand("show", "the computer system, interfaces, gateways and DNS servers");
  show->add_option("hosts", options.hosts, "[SCHEME://]HOST[:PORT][/NAMESPACE]; the rest is that of --url")
      ->type_name("HOST");
  show->add_option("--hosts", options.hostsFile, "ask the servers of this file, one a line; - is the standard input")
      ->type_name("FILE");

  CLI::App* set = app.add_subcommand("set", "change address and mask, and read back until they are there");
  set->add_option("interface", options.interface, "the interface, as show names it")
      ->type_name("INTERFACE")
      ->required();
  CLI::Option* whole = set->add_option("wanted", address, "address and length of the prefix: 192.0.2.77/25")
                           ->type_name("ADDRESS[/LENGTH]");
  set->add_option("--address", newAddress, "the address alone")->type_name("ADDRESS")->excludes(whole);
  set->add_option("--mask", options.newMask, "the subnet mask: 255.255.255.128")->type_name("MASK");
  set->add_flag("--dry-run", options.dryRun, "show what would be sent, and send nothing");
  set->add_flag("--yes", options.yes, "ask nothing, also where the change cuts this very connection");
  set->add_option("--wait", wait, "how long to wait for the change to show (10)")->type_name("SECONDS");

  CLI::App* watch = app.add_subcommand("watch", "changes as they come, until it is interrupted");
  watch->add_option("--interval", interval, "how often to look (2)")->type_name("SECONDS");

  CLI::App* model = app.add_subcommand("model", "what is associated with what, as a tree");
  model->add_option("--svg", options.svgFile, "draw it into this file instead; - is the standard output")
      ->type_name("FILE");

  try {
    app.parse(argc, argv);
    applySettings(options, given, configurationFile);
    if (!wait.empty()) {
      options.wait = secondsOf("--wait", wait, std::chrono::milliseconds(0));
    }
    if (!interval.empty()) {
      options.interval = secondsOf("--interval", interval, std::chrono::milliseconds(100));
    }
    if (!user.empty()) {
      options.access.user = user;
      options.access.password.clear();
      options.access.netrc = false;
      options.askPassword = true;
    }
    if (!address.empty()) {
      const Ipv4Settings wanted = parseAddressWithPrefix(address);
      if (!wanted.mask.empty() && !options.newMask.empty()) {
        throw UsageError("the mask is given twice: by the length of the prefix and by --mask");
      }
      options.newAddress = wanted.address;
      options.newMask = wanted.mask.empty() ? options.newMask : wanted.mask;
    } else {
      options.newAddress = newAddress;
    }
  } catch (const CLI::Success& asked) {
    app.exit(asked);
    return std::nullopt;
  } catch (const CLI::ParseError& error) {
    throw UsageError(std::string(error.what()) + " (bmcip --help shows the options)");
  } catch (const std::invalid_argument& refusal) {
    throw UsageError(refusal.what());
  }
  if (set->parsed() && options.newAddress.empty() && options.newMask.empty()) {
    throw UsageError("set needs an address, 192.0.2.77/25, or --address or --mask");
  }
  options.command = show->parsed()    ? Command::Show
                    : set->parsed()   ? Command::Set
                    : watch->parsed() ? Command::Watch
                                      : Command::Model;
  return options;
}

}  // namespace Bmcip
