// SPDX-License-Identifier: Apache-2.0
// Every request that the twelve providers can be sent, in the shapes that lead them different ways.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cimom/model/ObjectPath.h"
#include "tests/faults/model/Model.h"
#include "tests/support/composite/Units.h"

namespace Testing {

using Model::Operation;

struct Request {
  const Unit* unit;
  Operation operation;
  std::string shape;  // says how it differs from the unit's others of the operation
  Cimom::ObjectPath path;
  std::optional<std::vector<const char*>> properties = {};  // with its null at the end

  // Of ModifyInstance.
  bool hasInstance = true;
  std::optional<std::string> address = {};
  std::optional<std::string> mask = {};
  std::vector<std::optional<std::string>> nodes = {};

  // Of the association operations.
  const char* associationClass = nullptr;
  const char* resultClass = nullptr;
  const char* role = nullptr;
  const char* resultRole = nullptr;

  std::string name() const { return unit->file + '/' + nameOf(operation) + '/' + shape; }
};

const std::vector<Request>& requests();
// Throws std::invalid_argument for a name that none bears.
const Request& requestOf(const std::string& name);

}  // namespace Testing
