// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Allocations.h"

#include <cstddef>
#include <cstdlib>
#include <new>

#ifdef LEAK_SANITIZER
#include <sanitizer/lsan_interface.h>
#endif

namespace Testing {

namespace {

bool counting = false;
long blocks = 0;

}  // namespace

CountedAllocations::CountedAllocations(bool counted) : outer_(counting) { counting = counted; }
CountedAllocations::~CountedAllocations() { counting = outer_; }

long libraryBlocks() { return blocks; }

#ifdef LEAK_SANITIZER
bool sanitizerFindsLeaks() { return __lsan_do_recoverable_leak_check() != 0; }
#else
bool sanitizerFindsLeaks() { return false; }
#endif

}  // namespace Testing

#ifndef SANITIZED

namespace Testing {

namespace {

// Stands in front of every block.
struct Header {
  std::size_t owner;
  std::size_t unused;
};
static_assert(sizeof(Header) % (2 * sizeof(void*)) == 0);

constexpr std::size_t headerSize =
    sizeof(Header) < alignof(std::max_align_t) ? alignof(std::max_align_t) : sizeof(Header);
constexpr std::size_t library = 0x6c696272;
constexpr std::size_t other = 0x6f746865;
constexpr std::size_t freed = 0x66726565;

void* allocate(std::size_t size) {
  auto* block = static_cast<char*>(std::malloc(size + headerSize));
  if (!block) {
    throw std::bad_alloc();
  }
  reinterpret_cast<Header*>(block)->owner = counting ? library : other;
  blocks += counting ? 1 : 0;
  return block + headerSize;
}

void release(void* pointer) {
  if (!pointer) {
    return;
  }
  char* block = static_cast<char*>(pointer) - headerSize;
  auto* header = reinterpret_cast<Header*>(block);
  if (header->owner != library && header->owner != other) {
    std::abort();  // freed twice, or not allocated
  }
  blocks -= header->owner == library ? 1 : 0;
  header->owner = freed;
  std::free(block);
}

}  // namespace

}  // namespace Testing

void* operator new(std::size_t size) { return Testing::allocate(size); }
void* operator new[](std::size_t size) { return Testing::allocate(size); }
void operator delete(void* pointer) noexcept { Testing::release(pointer); }
void operator delete[](void* pointer) noexcept { Testing::release(pointer); }
void operator delete(void* pointer, std::size_t) noexcept { Testing::release(pointer); }
void operator delete[](void* pointer, std::size_t) noexcept { Testing::release(pointer); }

#endif
