// SPDX-License-Identifier: Apache-2.0
// Builds the composite instances, writes configuration changes, and resolves the far ends of associations.
#pragma once

#include <cmpimacs.h>

#include <string>
#include <vector>

namespace QV::IPConfigComposite {

// The system-name field that the identifiers of the management processor's settings begin with.
inline constexpr const char* bmcComputername = "BMC";

// The composite classes: the factory's members that read all instances of one and make a single new one, and the row of
// the model (factory/Model.cpp) that says what it is.
#define IPCONFIG_COMPOSITE_CLASSES(PAIR)                                                                             \
  PAIR(getAllSPComputerCMPIInstances, makeSPComputerInstance, computerSystem)                                        \
  PAIR(getAllIPProtocolendptCMPIInstances, makeIPProtocolEndptInstance, ipProtocolEndpoint)                          \
  PAIR(getAllIPAssignmentSettingCMPIInstances, makeIPAssignmentSettingInstance, assignmentSettingSequence)           \
  PAIR(getAllStaticIPAssignmentSettingCMPIInstances, makeStaticIPAssignmentSettingInstance, staticAssignmentSetting) \
  PAIR(getAllDHCPAssignmentSettingCMPIInstances, makeDHCPAssignmentSettingInstance, dhcpAssignmentSetting)           \
  PAIR(getAllIPRemoteSAPCMPIInstances, makeIPRemoteSAPInstance, remoteServiceAccessPoint)

// A provider operation makes one on its stack, calls members and drops it: the factory holds nothing, and every call
// starts from the underlying classes as they are now.
//
// Conventions of all members: `ref` is the request's object path, whose namespace every path that is built carries,
// with the managed system's name as host. `properties` is the client's null-terminated property list, or null for all.
// Everything returned was made by the broker and belongs to it until the request ends. `status` (never null) is handed
// to every broker call and holds, on return, what the last of them left.
class IPConfigObjectFactory {
 public:
  // The read pairs of IPCONFIG_COMPOSITE_CLASSES.
  //
  // getAll… appends an instance for every underlying instance that belongs to the management processor to `out`, in the
  // order of the underlying enumeration. Returns 0 when the enumeration ran, also when the broker reported its failure
  // in `status`; 1 when `className` is not the pair's class (`status` is untouched) or, for the computer system, when
  // an array could not be made. `noFilter` false installs the property list and the class's keys as the property filter
  // of every instance.
  //
  // make… returns one new instance with its constant properties, or null if no object path could be made.
#define IPCONFIG_DECLARE_PAIR(getAll, make, row)                                                                  \
  int getAll(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* ref, const char* className,  \
             const char** properties, bool noFilter, std::vector<CMPIInstance*>& out, CMPIStatus* status);        \
  CMPIInstance* make(const CMPIBroker* broker, const CMPIObjectPath* ref, const char** properties, bool noFilter, \
                     CMPIStatus* status);
  IPCONFIG_COMPOSITE_CLASSES(IPCONFIG_DECLARE_PAIR)
#undef IPCONFIG_DECLARE_PAIR

  // The write members: take the new "IPv4Address" and "SubnetMask" from the client's instance `ci` and the interface's
  // name from the keys of the request's path `cop`, and hand them to executeModifyInstance. The broker, the context,
  // the property list and the flag are not consulted.
  //
  // The endpoint's returns what executeModifyInstance returned. The static settings' always returns 0. The remote
  // access point's changes nothing and returns 0: clients may write what this product does not carry out.
  int modifyIPProtocolendptCMPIInstance(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* cop,
                                        const char** properties, bool flag, const CMPIInstance* ci, CMPIStatus* status);
  int modifyStaticIPCMPIInstance(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* cop,
                                 const char** properties, bool flag, const CMPIInstance* ci, CMPIStatus* status);
  int modifyRemoteSAPCMPIInstance(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* cop,
                                  const char** properties, bool flag, const CMPIInstance* ci, CMPIStatus* status);

  // Writes address and mask (dotted text, unchecked) to the first interface node of exactly that name; an empty value
  // leaves that setting as it is. Returns 0 when the walk over the nodes ran, whether or not a node bears the name; 1
  // when there is no interface node or the instrumentation threw.
  int executeModifyInstance(std::string name, std::string ipv4Address, std::string subnetMask);

  // Reports its entry and does nothing (compatibility 23).
  void executeSAPModifyInstance(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* cop,
                                const CMPIInstance* ci, CMPIStatus* status, const char** properties);

  // The class at the far end of an association, seen from the source object's class; "" for a pair that the model does
  // not have. Never null; a static text. The result class that a client asks for takes no part.
  const char* get_assoc_targetClass_Name(const CMPIBroker* broker, const CMPIObjectPath* sourcePath,
                                         const char* assocClass, const char* resultClass, CMPIStatus* status);

  // A new keyless path of that class in the source's namespace, with the managed system's name as host; null for a pair
  // that the model does not have.
  CMPIObjectPath* get_assoc_targetClass_ObjectPath(const CMPIBroker* broker, const CMPIObjectPath* sourcePath,
                                                   const char* assocClass, const char* resultClass, CMPIStatus* status);

  // Appends the pieces of `text` between any of the characters in `delimiters` to `tokens`; empty pieces vanish.
  void Tokenize(const std::string& text, std::vector<std::string>& tokens, const std::string& delimiters);
};

// The shapes of the read pairs.
using GetAll = int (IPConfigObjectFactory::*)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*,
                                              const char**, bool, std::vector<CMPIInstance*>&, CMPIStatus*);
using Make = CMPIInstance* (IPConfigObjectFactory::*)(const CMPIBroker*, const CMPIObjectPath*, const char**, bool,
                                                      CMPIStatus*);

// The shape of the write members.
using Modify = int (IPConfigObjectFactory::*)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                                              const char**, bool, const CMPIInstance*, CMPIStatus*);

}  // namespace QV::IPConfigComposite
