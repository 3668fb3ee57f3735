// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Requests.h"

#include <stdexcept>

namespace Testing {

namespace {

using Cimom::ObjectPath;
using Cimom::Value;
using Keys = std::vector<std::pair<const char*, std::string>>;

ObjectPath pathOf(const std::string& className, const Keys& keys = {}) {
  ObjectPath path{"client.example", "root/cimv2", className, {}};
  for (const auto& [name, value] : keys) {
    path.keys.set(name, Value::string(value));
  }
  return path;
}

Keys accessPointKeys(const std::string& creationClass, const std::string& name) {
  return {{"SystemCreationClassName", Classes::computerSystem},
          {"SystemName", "sp1"},
          {"CreationClassName", creationClass},
          {"Name", name}};
}

// An instance that is there, as a client names it; `second` is one further down where there is one.
ObjectPath existing(const std::string& className, bool second = false) {
  if (className == Classes::computerSystem) {
    return pathOf(className, {{"CreationClassName", className}, {"Name", second ? "sp2" : "sp1"}});
  }
  if (className == Classes::endpoint) {
    return pathOf(className, accessPointKeys(className, second ? "eth1" : "eth0"));
  }
  if (className == Classes::remoteAccessPoint) {
    return pathOf(className, accessPointKeys("YRNx_RemoteAccessPoint", second ? "DNS:1" : "Gateway:eth0"));
  }
  if (className == Classes::sequence) {
    return pathOf(className, {{"InstanceID", second ? "BMC:eth0:dhcp" : "BMC:eth0:static"}});
  }
  return pathOf(className, {{"InstanceID", second ? "BMC:eth1" : "BMC:eth0"}});
}

struct Ends {
  const char* association;
  const char* first;
  const char* firstClass;
  const char* second;
  const char* secondClass;
};

const Ends& endsOf(const std::string& association) {
  static const Ends all[] = {
      {Classes::hostedAccessPoint, "Antecedent", Classes::computerSystem, "Dependent", Classes::endpoint},
      {Classes::remoteHostedAccessPoint, "Antecedent", Classes::computerSystem, "Dependent",
       Classes::remoteAccessPoint},
      {Classes::clientAccess, "Antecedent", Classes::remoteAccessPoint, "Dependent", Classes::endpoint},
      {Classes::elementSettingData, "ManagedElement", Classes::endpoint, "SettingData", Classes::sequence},
      {Classes::staticOrderedMember, "GroupComponent", Classes::sequence, "PartComponent", Classes::staticSetting},
      {Classes::dhcpOrderedMember, "GroupComponent", Classes::sequence, "PartComponent", Classes::dhcpSetting},
  };
  for (const Ends& ends : all) {
    if (association == ends.association) {
      return ends;
    }
  }
  throw std::invalid_argument("no association is called " + association);
}

ObjectPath existingAssociation(const std::string& className, bool there) {
  const Ends& ends = endsOf(className);
  ObjectPath path = pathOf(className);
  // The sequence of the DHCP settings is the second.
  const bool dhcp = className == Classes::dhcpOrderedMember;
  path.keys.set(ends.first, Value::reference(existing(ends.firstClass, dhcp)));
  path.keys.set(ends.second,
                Value::reference(there ? existing(ends.secondClass) : pathOf(ends.secondClass, {{"Name", "none"}})));
  return path;
}

constexpr Operation navigations[] = {Operation::Associators, Operation::AssociatorNames, Operation::References,
                                     Operation::ReferenceNames};

class Catalogue {
 public:
  std::vector<Request> requests;

  void addInstanceUnit(const Unit& unit) {
    const std::string& name = unit.className;
    const bool isSetting = name == Classes::sequence || name == Classes::staticSetting || name == Classes::dhcpSetting;
    addReading(unit, pathOf(name), isSetting ? "ElementName" : "Name", existing(name), existing(name, true),
               pathOf(name, {{"Name", "none"}, {"InstanceID", "none"}}));
    const std::string another = name == Classes::computerSystem ? Classes::endpoint : Classes::computerSystem;
    add({&unit, Operation::EnumInstanceNames, "of-another-class", pathOf(another)});
    add({&unit, Operation::EnumInstances, "of-another-class", pathOf(another)});
    add({&unit, Operation::GetInstance, "of-another-class", existing(another)});
    if (unit.acceptsModify) {
      addModify(unit);
    }
  }

  void addAssociationUnit(const Unit& unit) {
    const std::string& name = unit.className;
    addReading(unit, pathOf(name), endsOf(name).first, existingAssociation(name, true), std::nullopt,
               existingAssociation(name, false));
    const Ends& ends = endsOf(name);
    addNavigation(unit, "from-one-end", existing(ends.firstClass, name == Classes::dhcpOrderedMember));
    addNavigation(unit, "from-the-other-end", existing(ends.secondClass));
    add(navigation(unit, Operation::Associators, "from-an-unknown-class", pathOf("CIM_ManagedElement")));
    add(navigation(unit, Operation::ReferenceNames, "from-an-unknown-class", pathOf("CIM_ManagedElement")));
    for (const Operation operation : {Operation::Associators, Operation::AssociatorNames}) {
      Request foreign = navigation(unit, operation, "over-another-association", existing(ends.firstClass));
      foreign.associationClass = "CIM_Dependency";
      add(foreign);
      foreign.shape = "over-any-association";
      foreign.associationClass = nullptr;
      add(foreign);
    }
    addFiltered(unit, "with-filters-from-one-end", ends.firstClass, ends.first, ends.secondClass, ends.second);
    addFiltered(unit, "with-filters-from-the-other-end", ends.secondClass, ends.second, ends.firstClass, ends.first);
  }

  // What no unit carries out, and cleaning up.
  void addStubs(const Unit& unit) {
    for (const Operation operation :
         {Operation::CreateInstance, Operation::DeleteInstance, Operation::ExecQuery, Operation::Cleanup}) {
      add({&unit, operation, "stub", pathOf(unit.className)});
    }
    if (!unit.acceptsModify) {
      add({&unit, Operation::ModifyInstance, "stub", pathOf(unit.className)});
    }
    if (unit.createAssociationMI) {
      add({&unit, Operation::AssociationCleanup, "stub", pathOf(unit.className)});
    }
  }

 private:
  static std::vector<const char*> list(const char* name) { return {name, "Description", nullptr}; }

  void add(Request request) { requests.push_back(std::move(request)); }

  void addReading(const Unit& unit, const ObjectPath& path, const char* property, const ObjectPath& first,
                  const std::optional<ObjectPath>& second, const ObjectPath& none) {
    add({&unit, Operation::EnumInstanceNames, "all", path});
    add({&unit, Operation::EnumInstances, "all", path});
    add({&unit, Operation::EnumInstances, "with-properties", path, list(property)});
    add({&unit, Operation::EnumInstances, "without-properties", path, std::vector<const char*>{nullptr}});
    add({&unit, Operation::GetInstance, "there", first});
    add({&unit, Operation::GetInstance, "with-properties", first, list(property)});
    if (second) {
      add({&unit, Operation::GetInstance, "further-down", *second});
    }
    add({&unit, Operation::GetInstance, "not-there", none});
    add({&unit, Operation::GetInstance, "without-keys", path});
  }

  void addModify(const Unit& unit) {
    Request both{&unit, Operation::ModifyInstance, "both", existing(unit.className)};
    both.address = "192.0.2.7";
    both.mask = "255.255.255.0";
    both.nodes = {"lo", std::nullopt, "eth0", "eth0"};
    add(both);
    Request listed = both;
    listed.shape = "with-properties";
    listed.properties = list("SubnetMask");
    add(listed);
    Request address = both;
    address.shape = "address-alone";
    address.mask.reset();
    add(address);
    Request mask = both;
    mask.shape = "mask-alone";
    mask.address = "";
    add(mask);
    Request neither = both;
    neither.shape = "neither";
    neither.address.reset();
    neither.mask.reset();
    add(neither);
    Request elsewhere = both;
    elsewhere.shape = "of-no-node";
    elsewhere.path = existing(unit.className, true);
    add(elsewhere);
    Request nodeless = both;
    nodeless.shape = "without-nodes";
    nodeless.nodes.clear();
    add(nodeless);
    Request keyless = both;
    keyless.shape = "without-keys";
    keyless.path = pathOf(unit.className);
    add(keyless);
    Request longer = both;
    longer.shape = "of-another-form";
    longer.path = pathOf(unit.className, {{"InstanceID", "BMC:eth0:more"}, {"Name", "eth"}});
    add(longer);
    Request nothing = both;
    nothing.shape = "without-instance";
    nothing.hasInstance = false;
    add(nothing);
  }

  static Request navigation(const Unit& unit, Operation operation, const std::string& shape, const ObjectPath& source) {
    Request request{&unit, operation, shape, source};
    if (operation == Operation::Associators || operation == Operation::AssociatorNames) {
      request.associationClass = unit.className.c_str();
    }
    return request;
  }

  void addFiltered(const Unit& unit, const std::string& shape, const char* sourceClass, const char* role,
                   const char* farClass, const char* farRole) {
    for (const Operation operation : navigations) {
      Request filtered = navigation(unit, operation, shape, existing(sourceClass));
      filtered.resultClass = filtered.associationClass ? farClass : "CIM_Dependency";
      filtered.role = role;
      filtered.resultRole = farRole;
      filtered.properties = list("Name");
      add(filtered);
    }
  }

  void addNavigation(const Unit& unit, const std::string& shape, const ObjectPath& source) {
    for (const Operation operation : navigations) {
      add(navigation(unit, operation, shape, source));
    }
  }
};

std::vector<Request> catalogue() {
  Catalogue all;
  for (const Unit& unit : instanceUnits()) {
    all.addInstanceUnit(unit);
    all.addStubs(unit);
  }
  for (const Unit& unit : associationUnits()) {
    all.addAssociationUnit(unit);
    all.addStubs(unit);
  }
  return all.requests;
}

}  // namespace

const std::vector<Request>& requests() {
  static const std::vector<Request> all = catalogue();
  return all;
}

const Request& requestOf(const std::string& name) {
  for (const Request& request : requests()) {
    if (request.name() == name) {
      return request;
    }
  }
  throw std::invalid_argument("no request is called \"" + name + "\"");
}

}  // namespace Testing
