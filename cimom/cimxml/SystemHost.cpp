// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/SystemHost.h"

#include "cimom/model/Instance.h"
#include "cimom/model/Names.h"
#include "cimom/model/ObjectPath.h"

namespace Cimom::CimXml {
namespace {

// The hosts that objects in a namespace name, as far as it matters.
class Hosts {
 public:
  explicit Hosts(std::string_view nameSpace) : nameSpace_(bareNamespace(nameSpace)) {}

  // The one host; null if there is none or more than one.
  const std::string* only() const { return differ_ || first_.empty() ? nullptr : &first_; }

  void add(const Cimom::Value& value) {
    if (const ObjectPath* path = value.path()) {
      add(*path);
    } else if (const Cimom::Instance* instance = value.embedded()) {
      add(*instance);
    }
  }

 private:
  // That of a path, and of the references among its keys.
  void add(const ObjectPath& path) {
    if (!path.host.empty() && sameName(bareNamespace(path.nameSpace), nameSpace_)) {
      differ_ = differ_ || (!first_.empty() && !sameName(first_, path.host));
      first_ = first_.empty() ? path.host : first_;
    }
    for (const auto& [name, value] : path.keys) {
      if (const ObjectPath* key = value.path()) {
        add(*key);
      }
    }
  }

  void add(const Cimom::Instance& instance) {
    add(*instance.path());
    for (std::size_t index = 0; index < instance.size(); ++index) {
      if (const ObjectPath* reference = instance[index].path()) {
        add(*reference);
      }
    }
  }

  std::string_view nameSpace_;
  std::string first_;
  bool differ_ = false;
};

}  // namespace

std::string systemHost(const std::vector<Cimom::Value>& objects, const std::string& nameSpace,
                       const std::string& otherwise) {
  Hosts hosts(nameSpace);
  for (const Cimom::Value& object : objects) {
    hosts.add(object);
  }
  return hosts.only() ? *hosts.only() : otherwise;
}

}  // namespace Cimom::CimXml
