// SPDX-License-Identifier: Apache-2.0
#include "tests/cimom/cimxml/EndpointTest.h"

#include <cmpimacs.h>

#include <fstream>
#include <iterator>
#include <utility>

#include "Paths.h"
#include "cimom/cimxml/Document.h"

CMPI_EXTERN_C CMPIInstanceMI* ProbeProvider_Create_InstanceMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPI_EXTERN_C CMPIAssociationMI* ProbeProvider_Create_AssociationMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPI_EXTERN_C CMPIMethodMI* ProbeProvider_Create_MethodMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

namespace Testing {

using namespace Cimom;

EndpointTest::EndpointTest() : endpoint_(manager_.broker(), manager_.classes(), "server") {
  std::ifstream mof(SOURCE_DIR "/tests/support/probe/Probe.mof");
  manager_.loadSchemaText(std::string{std::istreambuf_iterator<char>(mof), {}}, "root/test", "Probe.mof");
  for (ProviderRegistration registration : readRegistration(SOURCE_DIR "/tests/support/probe/Probe.reg")) {
    manager_.addProvider(registration, &ProbeProvider_Create_InstanceMI, &ProbeProvider_Create_AssociationMI,
                         &ProbeProvider_Create_MethodMI);
  }
}

Http::Request EndpointTest::request(const std::string& method, const std::string& body) {
  Http::Request request{"POST", "/cimom", {}, body, {}};
  request.headers.add("CIMOperation", "MethodCall");
  request.headers.add("CIMProtocolVersion", "1.0");
  request.headers.add("CIMMethod", method);
  request.headers.add("CIMObject", "root%2Ftest");
  return request;
}

Http::Response EndpointTest::post(const std::string& method, const std::string& body) const {
  Http::Response response = endpoint_.handle(request(method, body));
  for (const std::string& piece : std::exchange(response.more, {})) {
    response.body += piece;
  }
  return response;
}

std::string EndpointTest::contentOf(const Http::Response& response, const std::string& method) {
  EXPECT_EQ(response.status, 200u) << response.body;
  EXPECT_NO_THROW(CimXml::Document(response.body)) << response.body;
  const std::string begin = "METHODRESPONSE NAME=\"" + method + "\">";
  const auto start = response.body.find(begin);
  const bool isIntrinsic = response.body.find("<IMETHODRESPONSE ") != std::string::npos;
  const auto end =
      response.body.find(std::string(isIntrinsic ? "</I" : "</") + "METHODRESPONSE></SIMPLERSP></MESSAGE></CIM>");
  if (start == std::string::npos || end == std::string::npos) {
    ADD_FAILURE() << "no response to " << method << ": " << response.body;
    return {};
  }
  return response.body.substr(start + begin.size(), end - start - begin.size());
}

std::string EndpointTest::returned(const std::string& method, const std::string& parameters) const {
  const std::string content = contentOf(post(method, intrinsicCall(method, parameters)), method);
  EXPECT_EQ(content.find("<ERROR"), std::string::npos) << content;
  return content;
}

std::string EndpointTest::failed(const std::string& method, const std::string& parameters) const {
  const std::string content = contentOf(post(method, intrinsicCall(method, parameters)), method);
  const CimXml::Document document(content);
  EXPECT_TRUE(document.root().is("ERROR")) << content;
  return document.root().attribute("CODE").value_or("") + ": " + document.root().attribute("DESCRIPTION").value_or("");
}

std::string thingName(const std::string& number) {
  return instanceName("TEST_Thing",
                      keyBinding("Name", "thing") + keyBinding("Number", number, "VALUETYPE=\"numeric\""));
}

}  // namespace Testing
