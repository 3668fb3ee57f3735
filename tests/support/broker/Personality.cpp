// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/Personality.h"

#include <cmpimacs.h>
#include <dlfcn.h>

#include <cstdlib>
#include <stdexcept>

namespace Testing {

namespace {

constexpr auto pastTheEnd = static_cast<CMPIrc>(18);  // OpenPegasus's own code

const Personality personalities[] = {
    // The CMPI 2.0 standard as cimomd reads it: its broker, unchanged.
    {
        .name = "standard",
        .loadFlags = RTLD_NOW | RTLD_LOCAL,
        .brokerVersion = CMPIVersion200,
        .tableVersion = CMPIVersion200,
        .hasMemoryServices = true,
        .hasCmpi2Slots = true,
        .traceCode = CMPI_RC_OK,
        .charactersSetStatus = true,
        .unsetTextsAreNull = false,
        .nullStringsAreObjects = false,
        .absentState = CMPI_nullValue | CMPI_notFound,
        .absentKeyCode = CMPI_RC_ERR_NO_SUCH_PROPERTY,
        .requestHost = "client.example",
        .marksKeysOfPaths = true,
        .countsUnsetKeys = false,
        .referencesKeepTheirHost = true,
        .instancesKeepTheirHost = true,
        .pathsShowUnsetKeys = false,
        .keysOfThePathWin = true,
        .marksKeyProperties = true,
        .filterDropsOthers = true,
        .keepsUndeclared = false,
        .takesIntegersOfAnyType = false,
        .wrongTypeCode = CMPI_RC_ERR_TYPE_MISMATCH,
        .unknownClass = UnknownClass::HasNoInstance,
        .itemState = CMPI_goodValue,
        .failedUpCallIsNull = true,
        .pastTheEndCode = pastTheEnd,
        .namesTheAssociation = true,
        .sendsDefaults = false,
        .listsModifiedProperties = false,
    },
    {
        .name = "sfcb",
        .loadFlags = RTLD_NOW | RTLD_GLOBAL,
        .brokerVersion = 0,
        .tableVersion = 1,
        .hasMemoryServices = true,
        .hasCmpi2Slots = false,
        .traceCode = CMPI_RC_ERR_NOT_SUPPORTED,
        .charactersSetStatus = false,
        .unsetTextsAreNull = true,
        .nullStringsAreObjects = true,
        .absentState = CMPI_notFound,
        .absentKeyCode = CMPI_RC_ERR_NOT_FOUND,
        .requestHost = nullptr,
        .marksKeysOfPaths = false,
        .countsUnsetKeys = false,
        .referencesKeepTheirHost = false,
        .instancesKeepTheirHost = false,
        .pathsShowUnsetKeys = true,
        .keysOfThePathWin = false,
        .marksKeyProperties = false,
        .filterDropsOthers = true,
        .keepsUndeclared = true,
        .takesIntegersOfAnyType = true,
        .wrongTypeCode = CMPI_RC_ERR_TYPE_MISMATCH,
        .unknownClass = UnknownClass::HasNoInstancePath,
        .itemState = CMPI_goodValue,
        .failedUpCallIsNull = false,
        .pastTheEndCode = CMPI_RC_OK,
        .namesTheAssociation = false,
        .sendsDefaults = true,
        .listsModifiedProperties = false,
    },
    {
        .name = "OpenPegasus",
        .loadFlags = RTLD_LAZY | RTLD_GLOBAL,
        .brokerVersion = CMPIVersion200,
        .tableVersion = CMPIVersion200,
        .hasMemoryServices = false,
        .hasCmpi2Slots = true,
        .traceCode = CMPI_RC_OK,
        .charactersSetStatus = true,
        .unsetTextsAreNull = false,
        .nullStringsAreObjects = false,
        .absentState = CMPI_nullValue | CMPI_notFound,
        .absentKeyCode = CMPI_RC_ERR_NOT_FOUND,
        .requestHost = "server.example",
        .marksKeysOfPaths = true,
        .countsUnsetKeys = true,
        .referencesKeepTheirHost = true,
        .instancesKeepTheirHost = true,
        .pathsShowUnsetKeys = true,
        .keysOfThePathWin = true,
        .marksKeyProperties = false,
        .filterDropsOthers = false,
        .keepsUndeclared = false,
        .takesIntegersOfAnyType = false,
        .wrongTypeCode = CMPI_RC_ERR_INVALID_DATA_TYPE,
        .unknownClass = UnknownClass::HasKeylessPaths,
        .itemState = CMPI_nullValue,
        .failedUpCallIsNull = true,
        .pastTheEndCode = pastTheEnd,
        .namesTheAssociation = true,
        .sendsDefaults = true,
        .listsModifiedProperties = true,
    },
};

}  // namespace

const Personality& personalityOf(const std::string& name) {
  std::string names;
  for (const Personality& personality : personalities) {
    if (personality.name == name) {
      return personality;
    }
    names += (names.empty() ? "" : ", ") + personality.name;
  }
  throw std::invalid_argument("BROKER_PERSONALITY is \"" + name + "\": must be one of " + names);
}

const Personality& personality() {
  static const Personality& running = [&]() -> const Personality& {
    const char* name = std::getenv("BROKER_PERSONALITY");
    return personalityOf(name ? name : "standard");
  }();
  return running;
}

}  // namespace Testing
