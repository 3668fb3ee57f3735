// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <filesystem>
#include <memory>
#include <string_view>

#include "cimom/broker/BrokerCore.h"
#include "cimom/model/Errors.h"
#include "cimom/providers/ProviderRegistration.h"
#include "cimom/routing/Router.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom {

// A CIM object manager without a wire: schema, registered providers and a CMPI 2.0 broker, through whose up-call
// table (CMPIBrokerFT) every CIM operation goes. Requests may run on several threads at once, each inside a
// RequestScope, once everything is loaded.
class ObjectManager {
 public:
  ObjectManager();
  // Cleans every provider up that was used, then unloads the libraries. No request may be under way. A provider whose
  // clean-up does not end stays, and all that it may use.
  ~ObjectManager();

  // Reads MOF from a file or from every *.mof under a directory.
  // Throws ConfigurationError "FILE:LINE: what is wrong".
  void loadSchema(const std::filesystem::path& fileOrDirectory);
  // Reads MOF from a text and shows its classes in the namespace; those under a `#pragma namespace` in theirs.
  void loadSchemaText(std::string_view mof, std::string_view nameSpace, std::string_view origin = "text");
  // Shows in the namespace what has been read so far without a `#pragma namespace`.
  void showSchema(std::string_view nameSpace);

  // Reads a registration file, or every *.reg of a directory (ProviderRegistration.h), and shows the classes in the
  // namespaces.
  // Throws ConfigurationError "FILE:LINE: what is wrong".
  void loadRegistration(const std::filesystem::path& fileOrDirectory);
  // Where libraries are looked for, after the directories added before.
  void addProviderDirectory(const std::filesystem::path& directory);
  // Registers a provider that is linked into this program; a factory of a type that the registration does not name
  // may be null.
  void addProvider(const ProviderRegistration& registration, InstanceFactory instanceFactory,
                   AssociationFactory associationFactory, MethodFactory methodFactory = nullptr);
  // How long a provider's factory or clean-up may take before nobody waits for it any more.
  void setProviderLimit(std::chrono::milliseconds limit);
  // Loads every registered library now and logs what cannot be had; requests for it try again, and fail with the
  // reason. Throws ConfigurationError for a class that the schema lacks, and if nothing can be had.
  void checkProviders();

  // Exact until it says otherwise; not while a request is under way.
  void setStrictness(Strictness strictness);

  // Where CMLogMessage goes; by default a line on the standard error output.
  void setLog(MessageSink sink);
  // Where CMTraceMessage goes; by default nowhere.
  void setTrace(MessageSink sink);

  const CMPIBroker* broker() const;
  const ClassRepository& classes() const;

 private:
  struct Parts;
  std::unique_ptr<Parts> parts_;
};

}  // namespace Cimom
