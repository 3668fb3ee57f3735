// SPDX-License-Identifier: Apache-2.0
// workload PART INTERFACES: carries out one part of what is measured, on a simulated management processor with that
// many interfaces, whose agent.ini the environment names. Under callgrind each step is counted alone and dumped under
// its name; a step is warmed up first, so that what is done once in a process is not counted. Prints the most memory
// that it took, in KiB.
#include <QV/ProviderHelper.h>
#include <cmpimacs.h>
#include <unistd.h>
#include <valgrind/callgrind.h>

#include <cstdlib>
#include <functional>
#include <iostream>
#include <map>
#include <numeric>
#include <stdexcept>
#include <string>

#include "bench/MinimalProvider.h"
#include "bench/Rounds.h"
#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "cimom/cimxml/Endpoint.h"
#include "tests/support/client/Enumeration.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Footprint.h"
#include "trace/Trace.h"

namespace {

using namespace Testing;
using Benchmark::roundsOfAStep;

template <typename Operation>
void counted(const char* step, Operation operation) {
  CALLGRIND_ZERO_STATS;
  operation();
  CALLGRIND_DUMP_STATS_AT(step);
}

template <typename Operation>
void measured(const char* step, Operation operation) {
  operation();
  counted(step, operation);
}

[[noreturn]] void fail(const std::string& reason) { throw std::runtime_error(reason); }

constexpr const char* nameSpace = "root/cimv2";
constexpr const char* minimalNameSpace = "root/minimal";
constexpr const char* endpointClass = "YRNx_MgmtHwIPProtocolEndPoint";

// The product's providers, and the minimal one for the endpoints of another namespace.
class Product {
 public:
  Product() {
    manager_.loadSchema(built("share/cimomd"));
    manager_.loadRegistration(built("share/cimomd/CompositeIPConfig.reg"));
    manager_.loadRegistration(built("share/cimomd/UnderlyingIPConfig.reg"));
    manager_.addProviderDirectory(built("lib"));
    Cimom::ProviderRegistration minimal;
    minimal.className = endpointClass;
    minimal.provider = "MinimalProvider";
    minimal.instance = true;
    minimal.namespaces = {minimalNameSpace};
    manager_.addProvider(minimal, &MinimalProvider_Create_InstanceMI, nullptr);
    manager_.checkProviders();
  }

  const CMPIBroker* broker() const { return manager_.broker(); }
  const Cimom::ClassRepository& classes() const { return manager_.classes(); }

 private:
  Cimom::ObjectManager manager_;
};

// The path of the last endpoint, as a client has it: from the names that are enumerated.
CMPIObjectPath* lastEndpointPath(const CMPIBroker* broker, Cimom::RequestScope& scope, const char* in) {
  const auto* path = CMNewObjectPath(broker, in, endpointClass, nullptr);
  CMPIObjectPath* last = nullptr;
  CMPIEnumeration* names = CBEnumInstanceNames(broker, scope.context(), path, nullptr);
  while (names && CMHasNext(names, nullptr)) {
    last = CMGetNext(names, nullptr).value.ref;
  }
  if (!last) {
    fail(std::string("there is no endpoint in ") + in);
  }
  return last;
}

// How many items the answer has; each is taken.
int taken(const CMPIEnumeration* answer, const CMPIStatus& status) {
  if (status.rc != CMPI_RC_OK || !answer) {
    fail("an up-call failed with status " + std::to_string(status.rc));
  }
  int count = 0;
  while (CMHasNext(answer, nullptr)) {
    CMGetNext(answer, nullptr);
    ++count;
  }
  return count;
}

void expect(int count, int expected, const char* step) {
  if (count != expected) {
    fail(std::string(step) + " answers " + std::to_string(count) + " objects, not " + std::to_string(expected));
  }
}

// An operation that is too short to be counted once.
template <typename Operation>
void measuredRepeatedly(const char* step, Operation operation) {
  measured(step, [&] {
    for (int round = 0; round < roundsOfAStep; ++round) {
      operation();
    }
  });
}

void traceLines(int) {
  static const std::string component = "Tarnwick.IPObjectFactory";
  const QV::IPConfigComposite::Frame frame(component, "IPConfigObjectFactory", "makeIPProtocolEndptInstance");
  measuredRepeatedly("entering", [&] { frame.entering(); });
  measuredRepeatedly("variable", [&] { frame.variable("systemname", "managed.example"); });
}

void candidates(int) {
  const Product product;
  Cimom::RequestScope scope(product.broker());
  const CMPIObjectPath* wanted = lastEndpointPath(product.broker(), scope, nameSpace);
  const CMPIObjectPath* same = lastEndpointPath(product.broker(), scope, nameSpace);
  CMPIObjectPath* other = lastEndpointPath(product.broker(), scope, nameSpace);
  CMAddKey(other, "Name", "another", CMPI_chars);
  measuredRepeatedly("another", [&] {
    if (QV::isObjPathsEqual(wanted, other, false)) {
      fail("two endpoints are the same");
    }
  });
  measuredRepeatedly("the same", [&] {
    if (!QV::isObjPathsEqual(wanted, same, false)) {
      fail("an endpoint is another than itself");
    }
  });
}

// The endpoints as an up-call enumerates them, from the library or from the minimal provider.
void enumerate(const Product& product, const char* step, const char* in, int interfaces) {
  measured(step, [&] {
    Cimom::RequestScope scope(product.broker());
    CMPIStatus status{};
    const auto* path = CMNewObjectPath(product.broker(), in, endpointClass, nullptr);
    expect(taken(CBEnumInstances(product.broker(), scope.context(), path, nullptr, &status), status), interfaces, step);
  });
}

void enumerations(int interfaces) {
  const Product product;
  enumerate(product, "library enumerate", nameSpace, interfaces);
  enumerate(product, "minimal enumerate", minimalNameSpace, interfaces);
}

void namesAndGet(int interfaces) {
  const Product product;
  const CMPIBroker* broker = product.broker();
  const auto operations = [&](const char* in, const char* names, const char* get) {
    measured(names, [&] {
      Cimom::RequestScope scope(broker);
      CMPIStatus status{};
      const auto* path = CMNewObjectPath(broker, in, endpointClass, nullptr);
      expect(taken(CBEnumInstanceNames(broker, scope.context(), path, &status), status), interfaces, names);
    });
    Cimom::RequestScope outer(broker);
    const CMPIObjectPath* path = lastEndpointPath(broker, outer, in);
    measured(get, [&] {
      Cimom::RequestScope scope(broker);
      CMPIStatus status{};
      expect(CBGetInstance(broker, scope.context(), path, nullptr, &status) ? 1 : 0, 1, get);
    });
  };
  operations(nameSpace, "library names", "library get");
  operations(minimalNameSpace, "minimal names", "minimal get");
}

// From one endpoint to the settings that apply to it, two for each interface; and the instances of the association.
void associations(int interfaces) {
  const Product product;
  const CMPIBroker* broker = product.broker();
  constexpr const char* association = "YRNx_MgmtHwIPElementSettingData";
  const int settings = 2 * interfaces;
  Cimom::RequestScope outer(broker);
  const CMPIObjectPath* source = lastEndpointPath(broker, outer, nameSpace);
  const auto fromEndpoint = [&](const char* step, const auto& operation) {
    measured(step, [&] {
      Cimom::RequestScope scope(broker);
      CMPIStatus status{};
      expect(taken(operation(scope.context(), source, &status), status), settings, step);
    });
  };
  fromEndpoint("associators", [&](const CMPIContext* ctx, const CMPIObjectPath* path, CMPIStatus* status) {
    return CBAssociators(broker, ctx, path, association, nullptr, nullptr, nullptr, nullptr, status);
  });
  fromEndpoint("associator names", [&](const CMPIContext* ctx, const CMPIObjectPath* path, CMPIStatus* status) {
    return CBAssociatorNames(broker, ctx, path, association, nullptr, nullptr, nullptr, status);
  });
  fromEndpoint("references", [&](const CMPIContext* ctx, const CMPIObjectPath* path, CMPIStatus* status) {
    return CBReferences(broker, ctx, path, association, nullptr, nullptr, status);
  });
  fromEndpoint("reference names", [&](const CMPIContext* ctx, const CMPIObjectPath* path, CMPIStatus* status) {
    return CBReferenceNames(broker, ctx, path, association, nullptr, status);
  });
  measured("enumerate pairs", [&] {
    Cimom::RequestScope scope(broker);
    CMPIStatus status{};
    const auto* all = CMNewObjectPath(broker, nameSpace, association, nullptr);
    expect(taken(CBEnumInstances(broker, scope.context(), all, nullptr, &status), status), settings * interfaces,
           "enumerate pairs");
  });
}

// A whole request of CIM-XML, as the HTTP server hands it over.
void request(int interfaces) {
  const Product product;
  const Cimom::CimXml::Endpoint endpoint(product.broker(), product.classes(), "server.example");
  const auto instancesOf = [&](const char* className) {
    Cimom::Http::Request message{"POST", "/cimom", {}, enumerationOf(className), {}};
    for (const auto& [name, value] : enumerationHeaders()) {
      message.headers.add(name, value);
    }
    const Cimom::Http::Response response = endpoint.handle(message);
    const auto inMore = [](int sum, const std::string& piece) { return sum + instancesIn(piece); };
    return std::accumulate(response.more.begin(), response.more.end(), instancesIn(response.body), inMore);
  };
  // Warmed up by the one system, since ten thousand interfaces take a minute to count.
  expect(instancesOf("YRNx_MgmtHwComputerSystem"), 1, "the warming up");
  counted("request", [&] { expect(instancesOf(endpointClass), interfaces, "request"); });
}

const std::map<std::string, void (*)(int)> parts = {{"associations", associations}, {"candidates", candidates},
                                                    {"enumerations", enumerations}, {"names-and-get", namesAndGet},
                                                    {"request", request},           {"trace-lines", traceLines}};

}  // namespace

int main(int argc, char** argv) {
  const auto part = argc == 3 ? parts.find(argv[1]) : parts.end();
  if (part == parts.end()) {
    std::cerr << "usage: workload associations|candidates|enumerations|names-and-get|request|trace-lines "
                 "INTERFACES\n";
    return 2;
  }
  try {
    part->second(std::atoi(argv[2]));
    std::cout << peakResidentKib(::getpid()) << '\n';
    return 0;
  } catch (const std::exception& error) {
    std::cerr << "workload: " << part->first << ": " << error.what() << '\n';
    return 1;
  }
}
