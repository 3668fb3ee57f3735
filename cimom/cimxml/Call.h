// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpimacs.h>

#include <optional>
#include <string>
#include <vector>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/ObjectBuilder.h"
#include "cimom/cimxml/ObjectWriter.h"
#include "cimom/cimxml/Operations.h"
#include "cimom/cimxml/Parameters.h"

namespace Cimom::CimXml {

// An intrinsic method being performed, inside a request scope.
struct Call {
  const OperationContext& manager;
  const Request& request;
  const Parameters& parameters;
  const CMPIContext* context;
  const ObjectBuilder& objects;
  XmlWriter& xml;

  ObjectWriter writer(PropertyFilter filter = {}) const {
    return {xml, manager.host, request.nameSpace, std::move(filter)};
  }

  CMPIObjectPath* classPath(const std::string& className) const {
    return objects.path(ObjectName{{}, {}, className, {}});
  }
};

// Writes IRETURNVALUE with every object of the result of an up-call.
template <typename Write>
void writeResult(const Call& call, const CMPIStatus& status, CMPIEnumeration* result, Write write) {
  requireOk(status, result);
  const auto scope = call.xml.element("IRETURNVALUE");
  while (CMHasNext(result, nullptr)) {
    CMPIStatus next{CMPI_RC_OK, nullptr};
    const CMPIData data = CMGetNext(result, &next);
    requireOk(next, data.value.dataPtr.ptr);
    write(data.value);
  }
}

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

// The operations that read the schema; each writes IRETURNVALUE.
void getClass(Call& call);
void enumerateClasses(Call& call);
void enumerateClassNames(Call& call);

// A method of a class; writes RETURNVALUE, unless it returns null, and a PARAMVALUE for each output argument.
void callMethod(const OperationContext& manager, const Request& request, XmlWriter& xml);

}  // namespace Cimom::CimXml
