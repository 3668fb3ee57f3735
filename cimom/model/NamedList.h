// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <bit>
#include <cstdint>
#include <string_view>
#include <utility>
#include <vector>

#include "cimom/model/Names.h"

namespace Cimom {

// Elements in their order, found by their names without regard to case. A name stays what it was when its element came;
// of two elements with one name the first is found.
template <typename Element>
class NamedList {
 public:
  using value_type = Element;

  void push_back(Element element) {
    elements_.push_back(std::move(element));
    if (2 * elements_.size() > slots_.size()) {
      slots_.assign(std::bit_ceil(4 * elements_.size()), 0);
      for (std::size_t index = 0; index < elements_.size(); ++index) {
        enter(index);
      }
    } else {
      enter(elements_.size() - 1);
    }
  }

  void clear() {
    elements_.clear();
    slots_.clear();
  }

  // The first element of that name, or null.
  const Element* find(std::string_view name) const {
    const std::uint32_t number = slots_.empty() ? 0 : slots_[slotOf(name)];
    return number > 0 ? &elements_[number - 1] : nullptr;
  }
  Element* find(std::string_view name) { return const_cast<Element*>(std::as_const(*this).find(name)); }

  std::size_t indexOf(const Element& element) const { return static_cast<std::size_t>(&element - elements_.data()); }

  std::size_t size() const { return elements_.size(); }
  bool empty() const { return elements_.empty(); }
  const Element& operator[](std::size_t index) const { return elements_[index]; }
  const Element& at(std::size_t index) const { return elements_.at(index); }
  const Element& front() const { return elements_.front(); }
  const Element& back() const { return elements_.back(); }
  auto begin() const { return elements_.begin(); }
  auto end() const { return elements_.end(); }
  auto begin() { return elements_.begin(); }
  auto end() { return elements_.end(); }

 private:
  // The slot that has the name's element, or the empty one that it would have.
  std::size_t slotOf(std::string_view name) const {
    std::size_t slot = NameHash()(name) & (slots_.size() - 1);
    while (slots_[slot] > 0 && !sameName(elements_[slots_[slot] - 1].name, name)) {
      slot = (slot + 1) & (slots_.size() - 1);
    }
    return slot;
  }

  void enter(std::size_t index) {
    std::uint32_t& number = slots_[slotOf(elements_[index].name)];
    number = number > 0 ? number : static_cast<std::uint32_t>(index + 1);
  }

  std::vector<Element> elements_;
  std::vector<std::uint32_t> slots_;  // the number of an element, from 1, or 0; half of them at most are taken
};

}  // namespace Cimom
