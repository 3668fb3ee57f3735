// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Parameters.h"

#include <cmpidt.h>

#include <algorithm>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/ScalarText.h"
#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

// More than any class has. Providers go through the list for every instance.
constexpr std::size_t mostProperties = 4096;

[[noreturn]] void refuse(std::string_view name, const char* what) {
  throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "parameter " + std::string(name) + " " + what);
}

// The value of a parameter that may be missing; null then.
template <typename Kind>
const Kind* valueOf(const Parameter* parameter, const char* otherwise) {
  if (!parameter) {
    return nullptr;
  }
  const auto* value = std::get_if<Kind>(&parameter->value);
  if (!value) {
    refuse(parameter->name, otherwise);
  }
  return value;
}

}  // namespace

Parameters::Parameters(const Request& request, const std::vector<std::string_view>& known) : request_(request) {
  for (auto parameter = request.parameters.begin(); parameter != request.parameters.end(); ++parameter) {
    const auto isSame = [parameter](const auto& other) { return sameName(parameter->name, other); };
    if (std::none_of(known.begin(), known.end(), isSame)) {
      refuse(parameter->name, "is unknown");
    }
    if (std::any_of(request.parameters.begin(), parameter,
                    [&](const Parameter& other) { return isSame(other.name); })) {
      refuse(parameter->name, "is a duplicate");
    }
  }
}

const Parameter* Parameters::find(std::string_view name) const {
  const auto parameter =
      std::find_if(request_.parameters.begin(), request_.parameters.end(), [name](const Parameter& candidate) {
        return sameName(candidate.name, name) && !std::holds_alternative<std::monostate>(candidate.value);
      });
  return parameter == request_.parameters.end() ? nullptr : &*parameter;
}

std::optional<std::string> Parameters::text(std::string_view name) const {
  const auto* text = valueOf<std::string>(find(name), "must be text");
  if (!text) {
    return std::nullopt;
  }
  return *text;
}

bool Parameters::flag(std::string_view name, bool whenMissing) const {
  const auto value = text(name);
  if (!value) {
    return whenMissing;
  }
  const auto parsed = parseScalar(CMPI_boolean, *value);
  if (!parsed) {
    refuse(name, "must be TRUE or FALSE");
  }
  return parsed->boolean != 0;
}

std::optional<std::uint32_t> Parameters::number(std::string_view name) const {
  const auto value = text(name);
  if (!value) {
    return std::nullopt;
  }
  const auto parsed = parseScalar(CMPI_uint32, *value);
  if (!parsed) {
    refuse(name, "must be a number from 0 to 4294967295");
  }
  return parsed->uint32;
}

std::string Parameters::requiredText(std::string_view name) const {
  auto value = text(name);
  if (!value) {
    refuse(name, "is missing");
  }
  return *std::move(value);
}

std::string Parameters::className(std::string_view name) const {
  const auto* value = valueOf<ObjectName>(find(name), "must be a class name");
  if (!value) {
    return {};
  }
  if (!value->keys.empty()) {
    refuse(name, "must be a class name");
  }
  return value->className;
}

std::string Parameters::requiredClassName(std::string_view name) const {
  auto value = className(name);
  if (value.empty()) {
    refuse(name, "is missing");
  }
  return value;
}

const ObjectName& Parameters::instanceName(std::string_view name) const {
  const auto* value = valueOf<ObjectName>(find(name), "must be an instance name");
  if (!value) {
    refuse(name, "is missing");
  }
  return *value;
}

const Instance& Parameters::instance(std::string_view name) const {
  const auto* value = valueOf<Instance>(find(name), "must be an instance");
  if (!value) {
    refuse(name, "is missing");
  }
  return *value;
}

std::optional<std::vector<std::string>> Parameters::propertyList() const {
  const auto* texts = valueOf<Texts>(find("PropertyList"), "must be a list of names");
  if (!texts) {
    return std::nullopt;
  }
  if (texts->size() > mostProperties) {
    refuse("PropertyList", "must not have more than 4096 names");
  }
  std::vector<std::string> names;
  for (const auto& text : *texts) {
    if (text) {
      names.push_back(*text);
    }
  }
  return names;
}

}  // namespace Cimom::CimXml
