// SPDX-License-Identifier: Apache-2.0
// What the library must do with a request, stated a second time and independently: plain steps over the same function
// tables and the same agent, in the order in which they must happen, with what follows from every failure. Nothing of
// factory/ and providers/ is used or looked at; where the two differ, one of them is wrong.
#pragma once

#include <cmpift.h>

#include <string>

namespace Testing::Model {

enum class Operation {
  EnumInstanceNames,
  EnumInstances,
  GetInstance,
  ModifyInstance,
  CreateInstance,
  DeleteInstance,
  ExecQuery,
  Cleanup,
  Associators,
  AssociatorNames,
  References,
  ReferenceNames,
  AssociationCleanup,
};

std::string nameOf(Operation operation);

struct Request {
  // The provider that is asked.
  std::string className;
  std::string component;  // its logger
  std::string file;       // its name in the lines
  std::string prefix;     // of its operations there
  bool servesAssociation;
  bool acceptsModify;

  Operation operation;
  const CMPIBroker* broker;
  const CMPIContext* context;
  const CMPIResult* result;
  CMPIObjectPath* path;
  const CMPIInstance* instance;  // of ModifyInstance
  const char** properties;
  const char* associationClass;  // of Associators and AssociatorNames
};

CMPIStatus answer(const Request& request);

}  // namespace Testing::Model
