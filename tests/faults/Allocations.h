// SPDX-License-Identifier: Apache-2.0
// What the code under test holds on the heap. Under AddressSanitizer, which has its own account, nothing is counted.
#pragma once

namespace Testing {

// While one lives, what this thread allocates is the library's; the interposed calls put it aside while they run.
class CountedAllocations {
 public:
  explicit CountedAllocations(bool counted = true);
  ~CountedAllocations();
  CountedAllocations(const CountedAllocations&) = delete;
  CountedAllocations& operator=(const CountedAllocations&) = delete;

 private:
  bool outer_;
};

// How many of the library's blocks are not freed.
long libraryBlocks();

// Checks for leaks as the sanitizer sees them; false without one.
bool sanitizerFindsLeaks();

}  // namespace Testing
