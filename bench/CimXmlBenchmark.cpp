// SPDX-License-Identifier: Apache-2.0
// What the wire costs: the same enumeration as a bare up-call, with CIM-XML around it, and over a kept-alive
// connection. The first is the baseline of the other two.
#include <benchmark/benchmark.h>
#include <cmpimacs.h>

#include <fstream>
#include <iterator>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "cimom/cimxml/Endpoint.h"
#include "cimom/http/Server.h"
#include "tests/cimom/cimxml/Messages.h"
#include "tests/support/client/HttpClient.h"

CMPI_EXTERN_C CMPIInstanceMI* ProbeProvider_Create_InstanceMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

namespace {

using namespace Cimom;

constexpr const char* headers =
    "CIMOperation: MethodCall\r\nCIMMethod: EnumerateInstances\r\nCIMObject: root%2Ftest\r\n";

struct Manager {
  Manager() {
    std::ifstream mof(SOURCE_DIR "/tests/support/probe/Probe.mof");
    manager.loadSchemaText(std::string{std::istreambuf_iterator<char>(mof), {}}, "root/test", "Probe.mof");
    for (ProviderRegistration registration : readRegistration(SOURCE_DIR "/tests/support/probe/Probe.reg")) {
      registration.association = false;
      if (registration.instance) {
        manager.addProvider(registration, &ProbeProvider_Create_InstanceMI, nullptr);
      }
    }
  }

  ObjectManager manager;
  CimXml::Endpoint endpoint{manager.broker(), manager.classes(), "server"};
};

Manager& instance() {
  static Manager manager;
  return manager;
}

const std::string body =
    Testing::intrinsicCall("EnumerateInstances", Testing::className("TEST_Thing"));  // three instances

void upCall(benchmark::State& state) {
  const CMPIBroker* broker = instance().manager.broker();
  for (auto _ : state) {
    RequestScope scope(broker);
    const CMPIObjectPath* path = CMNewObjectPath(broker, "root/test", "TEST_Thing", nullptr);
    CMPIEnumeration* result = CBEnumInstances(broker, scope.context(), path, nullptr, nullptr);
    while (CMHasNext(result, nullptr)) {
      benchmark::DoNotOptimize(CMGetNext(result, nullptr));
    }
  }
}
BENCHMARK(upCall)->Unit(benchmark::kMicrosecond);

void withCimXml(benchmark::State& state) {
  Http::Request request{"POST", "/cimom", {}, body, {}};
  request.headers.add("CIMOperation", "MethodCall");
  request.headers.add("CIMMethod", "EnumerateInstances");
  request.headers.add("CIMObject", "root%2Ftest");
  for (auto _ : state) {
    benchmark::DoNotOptimize(instance().endpoint.handle(request));
  }
}
BENCHMARK(withCimXml)->Unit(benchmark::kMicrosecond);

void overHttp(benchmark::State& state) {
  Http::Server server({}, [](const Http::Request& request) { return instance().endpoint.handle(request); });
  Testing::HttpClient client(server.port());
  for (auto _ : state) {
    if (client.post("/cimom", body, headers).status != 200) {
      state.SkipWithError("the request failed");
    }
  }
}
BENCHMARK(overHttp)->Unit(benchmark::kMicrosecond)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
