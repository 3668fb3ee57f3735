// SPDX-License-Identifier: Apache-2.0
// A reply's message, as any server can send it: it is read, or refused with a Failure and nothing else. What was read
// goes on: names into requests, which stay well-formed, and texts onto a terminal, which they must not steer.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "bmcip/client/Operations.h"
#include "bmcip/output/Text.h"
#include "cimom/cimxml/Document.h"

namespace {

using namespace Bmcip;

void show(const std::string& text) {
  const std::string shown = tableOf({{"HEADING", text}, {text, "cell"}}, {});
  if (std::ranges::any_of(
          shown, [](char letter) { return (letter >= 0 && letter < ' ' && letter != '\n') || letter == 0x7f; })) {
    std::abort();
  }
}

void use(const ObjectName& name) {
  show(identityOf(name));
  const Cimom::CimXml::Document change(
      modifyInstance("root/cimv2", name, {{"IPv4Address", keyOf(name, "Name")}}).message);
  const Cimom::CimXml::Document question(associatorNames("root/cimv2", name, name.className).message);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view message(reinterpret_cast<const char*>(data), size);
  try {
    for (const Instance& instance : readInstances(message)) {
      use(instance.path);
      for (const auto& property : instance.properties) {
        show(textOf(instance, property.name));
      }
    }
  } catch (const Failure& failure) {
    show(failure.what());
  }
  try {
    for (const ObjectName& name : readNames(message)) {
      use(name);
    }
  } catch (const Failure&) {
  }
  return 0;
}
