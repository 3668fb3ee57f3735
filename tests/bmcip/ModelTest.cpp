// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include <filesystem>
#include <functional>

#include "tests/bmcip/BmcipTest.h"
#include "tests/support/system/Pattern.h"

namespace {

using namespace Testing;
using testing::HasSubstr;
using testing::StartsWith;

class BmcipModelTest : public BmcipStackTest {};

std::size_t count(const std::string& text, const std::string& part) {
  std::size_t found = 0;
  for (auto place = text.find(part); place != std::string::npos; place = text.find(part, place + 1)) {
    ++found;
  }
  return found;
}

TEST_F(BmcipModelTest, GrowsATree) {
  const Completed tree = bmcip({"model"});
  EXPECT_EQ(tree.status, 0) << tree.errors;
  EXPECT_THAT(tree.output, StartsWith("BMC\n├─ IPHostedAccessPoint\n│  ├─ eth0\n│  │  ├─ ClientAccess: Gateway:eth0, "
                                      "DNS:1, DNS:2\n│  │  └─ IPElementSettingData\n│  │     ├─ BMC:eth0:static\n"
                                      "│  │     │  └─ StaticIPOrderedMemberOfCollection: BMC:eth0\n"));
  EXPECT_THAT(tree.output, HasSubstr("\n└─ IPRemoteHostedAccessPoint: Gateway:eth0, DNS:1, DNS:2\n"));
}

// A system, 2 endpoints, 3 access points, 4 sequences, 2 static and 2 DHCP settings; 2 and 3 hosted, 6 by client
// access, 8 sequences of endpoints, and each of the 4 settings in the sequence of its kind.
TEST_F(BmcipModelTest, HasEveryInstanceAndEveryAssociation) {
  const std::string json = bmcip({"model", "--json"}).output;
  EXPECT_EQ(count(json, "\"class\":"), 14U);
  EXPECT_EQ(count(json, "\"association\":"), 23U);
}

TEST_F(BmcipModelTest, DrawsAPicture) {
  if (run({"sh", "-c", "command -v dot"}).status != 0) {
    GTEST_SKIP() << "dot (graphviz) is not there";
  }
  ASSERT_EQ(bmcip({"model", "--svg", directory_ / "model.svg"}).status, 0);
  const std::string svg = readFile(directory_ / "model.svg");
  EXPECT_EQ(count(svg, "class=\"node\""), 14U);
  EXPECT_EQ(count(svg, "class=\"edge\""), 23U + 0U);
  EXPECT_EQ(bmcip({"model", "--svg", "-"}).output, svg);
  const auto ordinateOf = [&](const std::string& name) {
    const Pattern::Match found = Pattern("y=\"(-?[0-9.]+)\"[^>]*>" + name + "</text>").first(svg);
    return found.empty() ? 0 : std::stod(found[1]);
  };
  EXPECT_LT(ordinateOf("eth0"), ordinateOf("eth1"));
}

TEST_F(BmcipModelTest, SaysWhatItNeedsToDraw) {
  environment_["PATH"] = "/nowhere";
  const Completed failed = bmcip({"model", "--svg", directory_ / "model.svg"});
  EXPECT_EQ(failed.status, 1);
  EXPECT_THAT(failed.errors, HasSubstr("graphviz"));
  EXPECT_THAT(readFile(directory_ / "model.svg"), testing::IsEmpty());
  const auto broken = directory_.write("dot", "#!/bin/sh\nexit 3\n");
  std::filesystem::permissions(broken, std::filesystem::perms::owner_all);
  environment_["PATH"] = directory_.path().string();
  EXPECT_THAT(bmcip({"model", "--svg", "-"}).errors, HasSubstr("the program dot failed"));
  directory_.write("dot", "#!/bin/sh\necho '<svg/>'\n");
  EXPECT_EQ(bmcip({"model", "--svg", "-"}).output, "<svg/>\n");
  EXPECT_THAT(bmcip({"model", "--svg", directory_.path().string()}).errors, HasSubstr(" cannot be written"));
}

// What no real part answers.
class BmcipModelAnswersTest : public BmcipTest {
 protected:
  using Contents = std::function<std::string(const Cimom::Http::Request& request)>;

  // @param contents what stands in the answer to a request
  Completed modelWhere(const Contents& contents) const {
    const Cimom::Http::Server server({}, [&](const Cimom::Http::Request& request) {
      Cimom::Http::Response response;
      response.body =
          "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP>"
          "<IMETHODRESPONSE NAME=\"X\">" +
          contents(request) + "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
      return response;
    });
    return bmcip({"model", "--json", "--url", "http://127.0.0.1:" + std::to_string(server.port())});
  }

  // Where systems are asked for, they are what is given; everything else is what is associated with them.
  static Contents where(const std::string& systems, const std::string& associated = "") {
    return [=](const Cimom::Http::Request& request) -> std::string {
      if (*request.headers.find("CIMMethod") == "AssociatorNames") {
        return associated;
      }
      return request.body.find("NAME=\"YRNx_MgmtHwComputerSystem\"") == std::string::npos ? "" : systems;
    };
  }

  static std::string names(const std::string& className, int count) {
    std::string names;
    for (int i = 0; i < count; ++i) {
      names += "<INSTANCENAME CLASSNAME=\"" + className + "\"><KEYBINDING NAME=\"Name\"><KEYVALUE>" +
               std::to_string(i) + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
    }
    return "<IRETURNVALUE>" + names + "</IRETURNVALUE>";
  }
};

TEST_F(BmcipModelAnswersTest, SaysWhatCannotBeTheModelOfAManagementProcessor) {
  const std::string system = names("YRNx_MgmtHwComputerSystem", 1);
  struct Row {
    Contents contents;
    int status;
    const char* says;
  };
  for (const Row& row : std::vector<Row>{
           {where(""), 14, "shows no instance: the providers are not registered"},
           {where(names("YRNx_MgmtHwComputerSystem", 1001)), 16, "more than 1000 instances"},
           {where(system, "<ERROR CODE=\"1\" DESCRIPTION=\"broken\"/>"), 15, "CIM status 1, failed: broken"},
           {where(system, "<IRETURNVALUE>"), 16, "the reply is not what CIM-XML knows"},
           {where(system, names("YRNx_MgmtHwIPProtocolEndPoint", 1)), 15,
            "IPHostedAccessPoint answers an instance that is none of its far end: YRNx_MgmtHwIPProtocolEndPoint"},
           {where(system, system), 15,
            "answers an instance that is none of its far end: YRNx_MgmtHwComputerSystem,name=0"}}) {
    const Completed failed = modelWhere(row.contents);
    EXPECT_EQ(failed.status, row.status) << row.says;
    EXPECT_THAT(failed.errors, HasSubstr(row.says));
    EXPECT_EQ(failed.output, "");
  }
  EXPECT_EQ(bmcip({"model", "--url", "http://127.0.0.1:1"}).status, 10);
}

TEST_F(BmcipModelAnswersTest, KeepsTheNameOfAClassOfAnotherSchema) {
  const Completed shown = modelWhere(where(names("OTHER_System", 1)));
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_THAT(shown.output, HasSubstr(R"("nodes":[{"class":"OTHER_System","name":"0"}],"edges":[])"));
}

}  // namespace
