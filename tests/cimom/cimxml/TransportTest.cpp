// SPDX-License-Identifier: Apache-2.0
// What makes a request a CIM operation over HTTP, and what is said of one that is none.
#include "tests/cimom/cimxml/EndpointTest.h"

namespace {

using namespace Testing;
using namespace Cimom;
using testing::HasSubstr;

class TransportTest : public EndpointTest {
 protected:
  // A request with its headers changed: an empty value takes the header away.
  Http::Response withHeader(const std::string& name, const std::string& value, const std::string& httpMethod = "POST",
                            const std::string& prefix = "") const {
    Http::Request changed{httpMethod, "/cimom", {}, message_, {}};
    for (const auto& [header, original] : request("EnumerateInstanceNames", "").headers) {
      if (header != name) {
        changed.headers.add(prefix + header, original);
      }
    }
    if (!value.empty()) {
      changed.headers.add(name, value);
    }
    return endpoint_.handle(changed);
  }

  static void expectRefused(const Http::Response& response, unsigned status, const std::string& cimError) {
    EXPECT_EQ(response.status, status) << response.body;
    const std::string* word = response.headers.find("CIMError");
    EXPECT_EQ(word ? *word : "", cimError) << response.body;
    EXPECT_EQ(response.body.find("<CIM"), std::string::npos);
    EXPECT_THAT(response.body, testing::EndsWith("\n"));
  }

  const std::string message_ = intrinsicCall("EnumerateInstanceNames", className("TEST_Unserved"));
};

TEST_F(TransportTest, MarksTheReplyAsAMethodResponse) {
  const Http::Response response = post("EnumerateInstanceNames", message_);
  EXPECT_EQ(response.status, 200u);
  EXPECT_EQ(*response.headers.find("CIMOperation"), "MethodResponse");
  EXPECT_EQ(*response.headers.find("Content-Type"), "application/xml; charset=\"utf-8\"");
  EXPECT_THAT(response.body, HasSubstr("<MESSAGE ID=\"4711\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP>"));
}

TEST_F(TransportTest, AnswersOnTheRootToo) {
  Http::Request other = request("EnumerateInstanceNames", message_);
  other.path = "/";
  EXPECT_EQ(endpoint_.handle(other).status, 200u);
  other.path = "/elsewhere";
  EXPECT_EQ(endpoint_.handle(other).status, 404u);
}

TEST_F(TransportTest, TakesTheExtensionHeadersOfMPost) {
  const std::string extension = "http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=73";
  const Http::Response response = withHeader("Man", extension, "M-POST", "73-");
  EXPECT_EQ(response.status, 200u) << response.body;
  EXPECT_EQ(*response.headers.find("73-CIMOperation"), "MethodResponse");
  EXPECT_TRUE(response.headers.find("Ext"));
}

TEST_F(TransportTest, RefusesAnMPostWithoutTheExtension) {
  expectRefused(withHeader("Man", "", "M-POST"), 510, "");
  expectRefused(withHeader("Man", "http://example.org/other; ns=73", "M-POST", "73-"), 510, "");
  for (const char* prefix : {"", " ; ns=", " ; ns=7", " ; ns=ab"}) {
    expectRefused(withHeader("Man", std::string("http://www.dmtf.org/cim/mapping/http/v1.0") + prefix, "M-POST"), 510,
                  "");
  }
}

TEST_F(TransportTest, RefusesHeadersWithoutThePrefixThatTheManHeaderDeclares) {
  expectRefused(withHeader("Man", "http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=73", "M-POST", "74-"), 400,
                "unsupported-operation");
}

TEST_F(TransportTest, NamesTheHttpMethodsItAllows) {
  for (const auto& [method, status] : {std::pair("GET", 405u), {"PUT", 405u}, {"OPTIONS", 405u}, {"BREW", 501u}}) {
    const Http::Response response = withHeader("X", "", method);
    EXPECT_EQ(response.status, status) << method;
    EXPECT_EQ(*response.headers.find("Allow"), "POST, M-POST");
  }
}

TEST_F(TransportTest, RefusesAnythingButAMethodCall) {
  expectRefused(withHeader("CIMOperation", ""), 400, "unsupported-operation");
  expectRefused(withHeader("CIMOperation", "MethodResponse"), 400, "unsupported-operation");
}

TEST_F(TransportTest, RefusesAnotherProtocolVersion) {
  expectRefused(withHeader("CIMProtocolVersion", "2.0"), 501, "unsupported-protocol-version");
  EXPECT_EQ(withHeader("CIMProtocolVersion", "1.4").status, 200u);
  EXPECT_EQ(withHeader("CIMProtocolVersion", "").status, 200u);
}

TEST_F(TransportTest, RefusesHeadersThatSayOtherThanTheMessage) {
  expectRefused(withHeader("CIMMethod", "GetInstance"), 400, "header-mismatch");
  expectRefused(withHeader("CIMMethod", ""), 400, "header-mismatch");
  expectRefused(withHeader("CIMObject", "root/other"), 400, "header-mismatch");
  expectRefused(withHeader("CIMObject", ""), 400, "header-mismatch");
}

TEST_F(TransportTest, TakesTheNamespaceInAnySpelling) {
  for (const char* spelling : {"root/test", "root%2ftest", "ROOT/Test", "/root/test/"}) {
    EXPECT_EQ(withHeader("CIMObject", spelling).status, 200u) << spelling;
  }
  for (const char* spelling : {"root%2", "root%zztest", "%"}) {
    expectRefused(withHeader("CIMObject", spelling), 400, "header-mismatch");
  }
}

TEST_F(TransportTest, RefusesABatch) {
  expectRefused(withHeader("CIMBatch", "CIMBatch"), 501, "multiple-requests-unsupported");
}

TEST_F(TransportTest, RefusesABodyThatIsNotARequest) {
  expectRefused(post("EnumerateInstanceNames", "<CIM"), 400, "request-not-well-formed");
  expectRefused(post("EnumerateInstanceNames", "<HTML/>"), 400, "request-not-valid");
}

}  // namespace
