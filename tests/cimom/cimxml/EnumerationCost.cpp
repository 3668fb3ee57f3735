// SPDX-License-Identifier: Apache-2.0
// enumeration_cost INSTANCES: has EnumerateInstances of a class with so many instances answered and prints
// "ALLOCATIONS BYTES": how often memory was allocated meanwhile, by whomever, and how long the answer is. Under
// callgrind the answer alone is counted, and a profile written for it.
#include <valgrind/callgrind.h>

#include <atomic>
#include <cstdlib>
#include <iostream>

#include "tests/cimom/cimxml/EndpointTest.h"
#include "tests/support/probe/ProbeObjects.h"

namespace {

std::atomic<long> allocations = 0;

class Server : public Testing::EndpointTest {
 public:
  using EndpointTest::endpoint_;
  using EndpointTest::request;

 private:
  void TestBody() override {}
};

}  // namespace

// The C library's own, which all others end in: operator new, libxml2.
extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* memory, std::size_t size);

void* malloc(std::size_t size) {
  ++allocations;
  return __libc_malloc(size);
}

void* calloc(std::size_t count, std::size_t size) {
  ++allocations;
  return __libc_calloc(count, size);
}

void* realloc(void* memory, std::size_t size) {
  ++allocations;
  return __libc_realloc(memory, size);
}
}

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: enumeration_cost INSTANCES\n";
    return 2;
  }
  // The part is a thing, too.
  Probe::setThings(static_cast<CMPIUint16>(std::atoi(argv[1]) - 1));
  const Server server;
  const auto request = Server::request("EnumerateInstances",
                                       Testing::intrinsicCall("EnumerateInstances", Testing::className("TEST_Thing")));
  server.endpoint_.handle(request);  // loads and makes what stays
  const long before = allocations;
  CALLGRIND_ZERO_STATS;
  const auto response = server.endpoint_.handle(request);
  CALLGRIND_DUMP_STATS_AT("answer");
  std::cout << allocations - before << ' ' << response.body.size() << std::endl;
  return 0;
}
