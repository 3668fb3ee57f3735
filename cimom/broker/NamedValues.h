#ifndef CIMOM_BROKER_NAMEDVALUES_H_
#define CIMOM_BROKER_NAMEDVALUES_H_

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/model/Names.h"
#include "cimom/model/Value.h"

namespace Cimom {

/// Values by name in the order in which they came: the keys of a path, the arguments of a method, the entries of a
/// context. Names are looked up without regard to case and keep the spelling that they were first given with.
class NamedValues {
 public:
  struct Entry {
    std::string name;
    Value value;
  };

  const Value* find(std::string_view name) const {
    const auto found = std::ranges::find_if(entries_, [&](const Entry& entry) { return sameName(entry.name, name); });
    return found == entries_.end() ? nullptr : &found->value;
  }

  void set(std::string_view name, Value value) {
    const auto found = std::ranges::find_if(entries_, [&](const Entry& entry) { return sameName(entry.name, name); });
    if (found == entries_.end()) {
      entries_.push_back({std::string(name), std::move(value)});
    } else {
      found->value = std::move(value);
    }
  }

  std::size_t size() const { return entries_.size(); }
  bool empty() const { return entries_.empty(); }
  const Entry& operator[](std::size_t index) const { return entries_[index]; }
  auto begin() const { return entries_.begin(); }
  auto end() const { return entries_.end(); }

 private:
  std::vector<Entry> entries_;
};

}  // namespace Cimom

#endif  // CIMOM_BROKER_NAMEDVALUES_H_
