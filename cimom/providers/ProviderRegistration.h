// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <filesystem>
#include <functional>
#include <string>
#include <tuple>
#include <vector>

namespace Cimom {

// Which provider serves a class, and where.
struct ProviderRegistration {
  std::string className;
  std::string provider;  // the name in the factory functions' names
  std::string location;  // the library lib<location>.so; of no meaning for a provider linked into the program
  bool instance = false;
  bool association = false;
  std::vector<std::string> namespaces;
  std::string registeredAt;  // "FILE:LINE", for messages
  bool method = false;
};

// A provider's factory functions, as CMPI defines them.
template <typename Mi>
using ProviderFactory = std::function<Mi*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>;
using InstanceFactory = ProviderFactory<CMPIInstanceMI>;
using AssociationFactory = ProviderFactory<CMPIAssociationMI>;
using MethodFactory = ProviderFactory<CMPIMethodMI>;
using ProviderFactories = std::tuple<InstanceFactory, AssociationFactory, MethodFactory>;

// Reads a registration file, or every *.reg of a directory: one stanza per class,
//
//     [ClassName]
//        provider: ProviderName
//        location: library
//        type: instance association method
//        namespace: root/cimv2
//     #
//
// `#` starts a comment; `group`, which other object managers take for their processes, is accepted and means nothing.
// Throws ConfigurationError "FILE:LINE: what is wrong".
std::vector<ProviderRegistration> readRegistration(const std::filesystem::path& fileOrDirectory);

}  // namespace Cimom
