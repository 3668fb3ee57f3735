// SPDX-License-Identifier: Apache-2.0
// How the object managers differ in what a provider can see of them. Nothing here is the library's doing: where a
// test's expectation depends on the object manager, it asks the row of the running one.
#pragma once

#include <cmpidt.h>

#include <string>

namespace Testing {

// What becomes of a class that the object manager does not know in the namespace. Its paths can be made everywhere.
enum class UnknownClass {
  HasNoInstance,      // an instance cannot be made
  HasNoInstancePath,  // it can, but has no path
  HasKeylessPaths,    // it can; no property is a key
};

struct Personality {
  std::string name;  // as BROKER_PERSONALITY gives it
  int loadFlags;     // of dlopen, for the library

  // The broker.
  unsigned int brokerVersion;  // that the up-call table reports
  int tableVersion;            // that every other function table reports
  bool hasMemoryServices;      // the table `mft`; else it is null
  bool hasCmpi2Slots;          // the slots that CMPI 2.0 added; else they are null
  CMPIrc traceCode;            // what the slot `trace` answers

  // Texts.
  bool charactersSetStatus;  // getCharPtr sets the status that it is handed
  bool unsetTextsAreNull;    // a host or namespace that nobody set is a string without characters, else the empty text
  bool nullStringsAreObjects;  // a null string value comes with a string object that has no characters

  // Values and names that are not there.
  CMPIValueState absentState;  // of a key or property that there is none of
  CMPIrc absentKeyCode;        // of a key; of a property every object manager says CMPI_RC_ERR_NO_SUCH_PROPERTY

  // Object paths.
  const char* requestHost;       // the host of a request's path; null if it has none
  bool marksKeysOfPaths;         // keys of paths carry CMPI_keyValue
  bool countsUnsetKeys;          // every path has all keys of its class; unset ones are counted and read as absent
  bool referencesKeepTheirHost;  // the host of a path that is set as a reference

  // Instances.
  bool instancesKeepTheirHost;  // the host of the path that an instance is made on
  bool pathsShowUnsetKeys;      // an instance's path has all keys of its class, unset ones as null
  bool keysOfThePathWin;        // over the key properties' current values
  bool marksKeyProperties;      // key properties carry CMPI_keyValue
  bool filterDropsOthers;       // after setPropertyFilter, sets of properties that are neither listed nor keys
  bool keepsUndeclared;         // properties that the class does not declare can be set and read back
  bool takesIntegersOfAnyType;  // an integer property takes on the integer type that it is set with
  CMPIrc wrongTypeCode;         // what setProperty answers where the type is refused
  UnknownClass unknownClass;

  // Up-calls.
  CMPIValueState itemState;  // of the items of an enumeration
  bool failedUpCallIsNull;   // else an empty enumeration comes with the error
  CMPIrc pastTheEndCode;     // what getNext answers there

  // Requests.
  bool namesTheAssociation;  // a client that names no association class: the provider is told its own, else null
  bool sendsDefaults;        // a property that the client did not send has its class's default, if any; else it is null
  bool listsModifiedProperties;  // ModifyInstance always comes with a property list; else with the client's, if any
};

// The personality that the tests run under: that of the environment variable BROKER_PERSONALITY, "standard" without it.
// Throws std::invalid_argument where no personality bears the name.
const Personality& personality();

const Personality& personalityOf(const std::string& name);

}  // namespace Testing
