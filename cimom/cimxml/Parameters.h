// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/cimxml/Request.h"

namespace Cimom::CimXml {

// The parameters of an intrinsic method, by name and kind. What is missing, given twice, not known or of another kind
// is an OperationError CIM_ERR_INVALID_PARAMETER that names it. A parameter without a value counts as not given.
class Parameters {
 public:
  // `known` are the names that the method has.
  Parameters(const Request& request, const std::vector<std::string_view>& known);

  bool flag(std::string_view name, bool whenMissing) const;
  std::optional<std::string> text(std::string_view name) const;
  // A uint32.
  std::optional<std::uint32_t> number(std::string_view name) const;

  // The name of a class; empty if none is given.
  std::string className(std::string_view name) const;

  // Throw if it is missing, too.
  std::string requiredText(std::string_view name) const;
  std::string requiredClassName(std::string_view name) const;
  const ObjectName& instanceName(std::string_view name) const;
  const Instance& instance(std::string_view name) const;

  // The names in a list of properties; nothing if no list is given, which means all of them.
  std::optional<std::vector<std::string>> propertyList() const;

  // The parameter as it came; null if it is not given.
  const Parameter* find(std::string_view name) const;

 private:
  const Request& request_;
};

}  // namespace Cimom::CimXml
