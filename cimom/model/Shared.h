// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <utility>

namespace Cimom {

// An object that its copies share until one of them is to be changed, which then goes on with an object of its own. To
// copy costs a count and never throws. Copies of one object may be with several threads; each copy is with one at a
// time. T need not be complete where a copy is kept.
template <typename T>
class Shared {
 public:
  Shared(T object) : node_(new Node(std::move(object))) {}  // a shared object is the object
  Shared(const Shared& other) noexcept : node_(other.node_) { node_->users.fetch_add(1, std::memory_order_relaxed); }
  Shared(Shared&& other) noexcept : node_(std::exchange(other.node_, nullptr)) {}
  Shared& operator=(Shared other) noexcept {
    std::swap(node_, other.node_);
    return *this;
  }
  ~Shared() {
    if (node_ && node_->users.fetch_sub(1, std::memory_order_acq_rel) == 1) {
      node_->destroy(node_);
    }
  }

  const T& operator*() const { return static_cast<const Node*>(node_)->object; }
  const T* operator->() const { return &**this; }

  // The object, to be changed: no other copy sees what happens to it.
  T& own() {
    if (node_->users.load(std::memory_order_acquire) != 1) {
      *this = Shared(T(**this));
    }
    return static_cast<Node*>(node_)->object;
  }

 private:
  struct Count {
    explicit Count(void (*destroyer)(Count*)) : destroy(destroyer) {}

    std::atomic<unsigned> users = 1;
    void (*destroy)(Count*);
  };

  struct Node : Count {
    explicit Node(T given) : Count([](Count* count) { delete static_cast<Node*>(count); }), object(std::move(given)) {}

    T object;
  };

  Count* node_;
};

}  // namespace Cimom
