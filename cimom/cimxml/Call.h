// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpimacs.h>

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/ObjectBuilder.h"
#include "cimom/cimxml/ObjectWriter.h"
#include "cimom/cimxml/Operations.h"
#include "cimom/cimxml/Parameters.h"
#include "cimom/cimxml/SystemHost.h"

namespace Cimom::CimXml {

// An intrinsic method being performed, inside a request scope.
struct Call {
  const OperationContext& manager;
  const Request& request;
  const Parameters& parameters;
  const CMPIContext* context;
  const ObjectBuilder& objects;
  XmlWriter& xml;
  std::string& host;  // stands in the answer's paths that name none

  // Gives the paths that name no host the one that the answer's objects name.
  void takeHostOf(const std::vector<Cimom::Value>& answered) const {
    host = systemHost(answered, request.nameSpace, manager.host);
  }

  ObjectWriter writer(PropertyFilter filter = {}) const { return {xml, host, request.nameSpace, std::move(filter)}; }

  CMPIObjectPath* classPath(const std::string& className) const {
    return objects.path(ObjectName{{}, {}, className, {}});
  }
};

// What an operation that enumerates has found: instances, or paths.
struct Found {
  // Throws OperationError for a status that is not OK.
  Found(const Call& call, const CMPIStatus& status, CMPIEnumeration* found, PropertyFilter shown = {});

  std::vector<Cimom::Value> objects;
  PropertyFilter properties;  // of instances: those that the client wants to see
};

// A text as CMPI takes one that may be missing.
inline const char* orNull(const std::string& text) { return text.empty() ? nullptr : text.c_str(); }

// A list of properties as CMPI takes it: names up to a null, or null itself for all properties.
class PropertyNames {
 public:
  explicit PropertyNames(const std::optional<std::vector<std::string>>& names) {
    if (!names) {
      return;
    }
    for (const auto& name : *names) {
      pointers_.push_back(name.c_str());
    }
    pointers_.push_back(nullptr);
  }

  const char** get() { return pointers_.empty() ? nullptr : pointers_.data(); }

 private:
  std::vector<const char*> pointers_;
};

// All properties, or those of the list.
inline PropertyFilter filterOf(const std::optional<std::vector<std::string>>& names) {
  return names ? PropertyFilter(*names) : PropertyFilter();
}

// Tells providers who asks; nothing if nobody was asked.
inline void addPrincipal(const CMPIContext* context, const std::string& user) {
  if (!user.empty()) {
    requireOk(CMAddContextEntry(context, CMPIPrincipal, user.c_str(), CMPI_chars));
  }
}

// What the operations find that return many objects. Those that start from an instance take the name of the parameter
// that names it, which is another one if the result is pulled.
Found findInstances(Call& call);
Found findInstanceNames(Call& call);
Found findAssociators(Call& call, std::string_view source);
Found findAssociatorNames(Call& call, std::string_view source);
Found findReferences(Call& call, std::string_view source);
Found findReferenceNames(Call& call, std::string_view source);

// The operations on instances; each writes IRETURNVALUE if it returns something.
void enumerateInstances(Call& call);
void enumerateInstanceNames(Call& call);
void getInstance(Call& call);
void createInstance(Call& call);
void modifyInstance(Call& call);
void deleteInstance(Call& call);
void getProperty(Call& call);
void setProperty(Call& call);

// The traversals of associations from an instance; each writes IRETURNVALUE.
void associators(Call& call);
void associatorNames(Call& call);
void references(Call& call);
void referenceNames(Call& call);

// The operations whose results are pulled; each writes IRETURNVALUE, and what the operation returns beside it.
void openEnumerateInstances(Call& call);
void openEnumerateInstancePaths(Call& call);
void openAssociatorInstances(Call& call);
void openAssociatorInstancePaths(Call& call);
void openReferenceInstances(Call& call);
void openReferenceInstancePaths(Call& call);
void pullInstancesWithPath(Call& call);
void pullInstancePaths(Call& call);
void closeEnumeration(Call& call);
void enumerationCount(Call& call);

// The operations that read the schema; each writes IRETURNVALUE.
void getClass(Call& call);
void enumerateClasses(Call& call);
void enumerateClassNames(Call& call);
void getQualifier(Call& call);
void enumerateQualifiers(Call& call);

// A method of a class; writes RETURNVALUE, unless it returns null, and a PARAMVALUE for each output argument.
void callMethod(const OperationContext& manager, const Request& request, XmlWriter& xml);

}  // namespace Cimom::CimXml
