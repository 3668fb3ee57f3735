// SPDX-License-Identifier: Apache-2.0
#include "tests/bmcip/BmcipTest.h"

#include "Paths.h"
#include "tests/support/system/Build.h"

namespace Testing {
namespace {

const std::string program = built("bin/bmcip");

std::vector<std::string> commandOf(const std::vector<std::string>& arguments) {
  std::vector<std::string> command = {program};
  command.insert(command.end(), arguments.begin(), arguments.end());
  return command;
}

}  // namespace

Environment BmcipTest::environment() const {
  Environment environment = {{"HOME", directory_.path().string()}, {"XDG_CONFIG_HOME", ""}, {"BMCIP_URL", ""}};
  for (const auto& [name, value] : environment_) {
    environment[name] = value;
  }
  return environment;
}

Completed BmcipTest::bmcip(const std::vector<std::string>& arguments) const {
  return run(commandOf(arguments), environment());
}

Process BmcipTest::start(const std::vector<std::string>& arguments) const {
  return Process(commandOf(arguments), environment());
}

std::string BmcipTest::lastLine(const std::string& text) {
  const std::vector<std::string> lines = linesOf(text);
  return lines.empty() ? "" : lines.back();
}

void BmcipTest::expectSchemaOf(const std::string& lines) const {
  if (run({"python3", "-c", "import jsonschema"}).status != 0) {
    GTEST_SKIP() << "python3-jsonschema is not there";
  }
  const std::string check =
      "import json, sys, jsonschema\n"
      "schema = json.load(open(sys.argv[1]))\n"
      "jsonschema.Draft7Validator.check_schema(schema)\n"
      "for line in open(sys.argv[2]): jsonschema.validate(json.loads(line), schema)\n"
      "try: jsonschema.validate({'server': 'x', 'interfaces': 1}, schema)\n"
      "except jsonschema.ValidationError: sys.exit(0)\n"
      "sys.exit('takes anything')\n";
  const auto file = directory_.write("lines", lines);
  const Completed checked = run({"python3", "-c", check, SOURCE_DIR "/docs/bmcip.schema.json", file.string()});
  EXPECT_EQ(checked.status, 0) << checked.errors;
}

BmcipStackTest::BmcipStackTest() { environment_["BMCIP_URL"] = url(); }

std::string BmcipStackTest::url() const { return "http://127.0.0.1:" + std::to_string(stack_.port()); }

RecordedServer::RecordedServer(const std::string& directory)
    : directory_(SOURCE_DIR "/tests/bmcip/replies/" + directory),
      files_{{"YRNx_MgmtHwComputerSystem", "system"},
             {"YRNx_MgmtHwIPProtocolEndPoint", "endpoints"},
             {"YRNx_MgmtHwRemoteServiceAccessPoint", "access-points"},
             {"ModifyInstance", "modified"}},
      server_({}, [this](const Cimom::Http::Request& request) { return respond(request); }) {}

Cimom::Http::Response RecordedServer::respond(const Cimom::Http::Request& request) {
  const std::lock_guard lock(mutex_);
  requests_.push_back(request.body);
  Cimom::Http::Response response;
  response.headers.add("Content-Type", "application/xml; charset=\"utf-8\"");
  response.headers.add("CIMOperation", "MethodResponse");
  const std::string* method = request.headers.find("CIMMethod");
  for (const auto& [question, file] : files_) {
    const bool asked = method && *method == "ModifyInstance"
                           ? question == *method
                           : request.body.find("<CLASSNAME NAME=\"" + question) != std::string::npos;
    if (asked) {
      response.body = readFile(directory_ + "/" + file + ".xml");
    }
  }
  if (response.body.empty()) {
    response.status = 400;
  }
  if (alteration_) {
    alteration_(response.body);
  }
  return response;
}

}  // namespace Testing
