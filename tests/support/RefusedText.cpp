#include "RefusedText.h"

#include <cstring>
#include <map>
#include <utility>

namespace Testing {

namespace {

struct Refusal {
  std::function<bool(const std::string&, int)> refuses;
  std::map<std::string, int> calls;
};

Refusal& refusal() {
  static Refusal current;
  return current;
}

}  // namespace

void refuseText(std::function<bool(const std::string&, int)> refuses) { refusal() = {std::move(refuses), {}}; }

}  // namespace Testing

// The linker gives these names to the callers' side and to the agent's own function.
bool wrappedTextEqual(const char* a, const char* b) __asm__("__wrap__ZN2QV9textEqualEPKcS1_");
bool realTextEqual(const char* a, const char* b) __asm__("__real__ZN2QV9textEqualEPKcS1_");

bool wrappedTextEqual(const char* a, const char* b) {
  Testing::Refusal& refusal = Testing::refusal();
  if (refusal.refuses && a != nullptr && b != nullptr && std::strcmp(a, b) == 0 &&
      refusal.refuses(a, ++refusal.calls[a])) {
    return false;
  }
  return realTextEqual(a, b);
}
