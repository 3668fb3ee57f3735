// SPDX-License-Identifier: Apache-2.0
// A request's body, as any client on the network can send it: what the reader takes goes on to the object manager with
// the probe's classes; what it does not take is refused with a TransportError and nothing else.
#include <cstddef>
#include <cstdint>
#include <fstream>
#include <iterator>
#include <memory>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/cimxml/Document.h"
#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/Operations.h"
#include "cimom/cimxml/Request.h"

namespace {

using namespace Cimom;

// The probe's schema without its provider: an operation runs up to the up-call.
const ObjectManager& manager() {
  static const auto instance = [] {
    auto loaded = std::make_unique<ObjectManager>();
    std::ifstream mof(SOURCE_DIR "/tests/support/probe/Probe.mof");
    loaded->loadSchemaText(std::string{std::istreambuf_iterator<char>(mof), {}}, "root/test", "Probe.mof");
    return loaded;
  }();
  return *instance;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static CimXml::OpenEnumerations openEnumerations;
  const std::string host = "host";
  const std::string user;
  try {
    const CimXml::Request request = CimXml::readRequest({reinterpret_cast<const char*>(data), size});
    CimXml::XmlWriter xml;
    {
      const auto root = xml.element("R");
      CimXml::perform({manager().broker(), manager().classes(), host, openEnumerations, user}, request, xml);
    }
    const CimXml::Document wellFormed(xml.take());
  } catch (const CimXml::TransportError&) {
  } catch (const CimXml::OperationError&) {
  }
  return 0;
}
