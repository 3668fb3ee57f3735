// SPDX-License-Identifier: Apache-2.0
// What stands behind those CMPI objects that are no CIM values themselves.
#pragma once

#include <cmpidt.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "cimom/broker/RequestScope.h"
#include "cimom/model/Shared.h"
#include "cimom/model/Value.h"

namespace Cimom {

// Characters, of its own or shared with a value, or in memory that lives as long as the text does.
struct Text {
  struct Kept {
    const char* characters;
  };

  explicit Text(std::string text) : Text(Shared<std::string>(std::move(text))) {}
  explicit Text(Shared<std::string> text) : characters(text->data()), owner(std::move(text)) {}
  explicit Text(Kept kept) : characters(kept.characters) {}

  const char* characters;
  std::optional<Shared<std::string>> owner;
};

struct Context {
  NamedValues entries;
  Deadline deadline;  // of the request that it belongs to, for a thread that is attached with it
};

struct Args {
  NamedValues arguments;
};

struct Enumeration {
  std::vector<Value> items;
  std::size_t next = 0;
};

// A CIM_Error that a provider fills in; texts that nobody set are absent.
struct Error {
  std::optional<std::string> owningEntity;
  std::optional<std::string> messageId;
  std::optional<std::string> message;
  CMPIErrorSeverity severity = {};
  CMPIErrorProbableCause probableCause = {};
  CMPIrc statusCode = CMPI_RC_OK;
  std::optional<std::string> statusCodeDescription;
  CMPIErrorType type = {};
  std::optional<std::string> otherType;
  std::optional<std::string> probableCauseDescription;
  std::optional<std::string> source;
  CMPIErrorSrcFormat sourceFormat = {};
  std::optional<std::string> otherSourceFormat;
  std::optional<Array> recommendedActions;
  std::optional<Array> messageArguments;
};

// What a provider delivers to one operation.
struct Result {
  CMPIType kind = CMPI_null;  // CMPI_instance or CMPI_ref if the operation takes only those; CMPI_null: anything
  std::vector<Value> items;
  std::optional<Error> error;  // the first error that the provider returned as a CMPIError
};

}  // namespace Cimom
