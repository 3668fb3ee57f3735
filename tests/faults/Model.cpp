// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Model.h"

#include <QV/Instrumentation.h>
#include <QV/ProviderHelper.h>
#include <TWLog/TWLog.h>
#include <cmpimacs.h>

#include <functional>
#include <stdexcept>

#include "tests/faults/ModelData.h"

namespace Testing {

namespace {

using namespace Model;

// What cannot be followed: a null pointer, or an object whose handle is null. A call that would have to be made on one
// is left out, and what it would have answered is empty.
template <typename Object>
bool usable(const Object* object) {
  return object && object->hdl;
}

// Reading

std::string charactersOf(const CMPIString* string, CMPIStatus* status) {
  const char* characters = usable(string) ? CMGetCharsPtr(string, status) : nullptr;
  return characters ? characters : "";
}

bool flaggedNull(const CMPIData& data) { return (data.state & 0x100) != 0; }

// A text, of a value that is not flagged null and is one, as a string or as bare characters.
std::string textIn(const CMPIData& data, CMPIStatus* status) {
  if (flaggedNull(data)) {
    return "";
  }
  if (data.type == CMPI_chars) {
    return data.value.chars ? data.value.chars : "";
  }
  return data.type == CMPI_string ? charactersOf(data.value.string, status) : "";
}

std::string nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status) {
  return charactersOf(CMGetNameSpace(path, status), status);
}

std::string classNameOf(const CMPIObjectPath* path, CMPIStatus* status) {
  return charactersOf(CMGetClassName(path, status), status);
}

std::string textProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status, CMPIStatus* characters) {
  return usable(instance) ? textIn(CMGetProperty(instance, name, status), characters) : "";
}

std::vector<std::string> fieldsOf(const std::string& text) {
  std::vector<std::string> fields;
  std::string field;
  for (const char character : text + ':') {
    if (character != ':') {
      field += character;
    } else if (!field.empty()) {
      fields.push_back(field);
      field.clear();
    }
  }
  return fields;
}

bool holds(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

// The lines of log and trace

constexpr int ordinary = 4000;
constexpr int failure = 6000;
const std::string rule(78, '=');

struct Reporter {
  std::string component;
  std::string file;
  std::string function;

  void entering(int line = 0) const { line_(ordinary, line, "ENTERING: " + place(line)); }
  void exiting(int line = 0) const { line_(ordinary, line, "EXITING: " + place(line)); }
  void message(const std::string& text, int level = ordinary, int line = 0) const {
    line_(level, line, "MESSAGE [File: " + file + ", Line: " + std::to_string(line) + "]: " + text);
  }
  void variable(const char* name, const std::string& value, int line = 0) const {
    line_(ordinary, line,
          std::string("VARIABLE: '") + name + "' has Value '" + value + "' at line " + std::to_string(line) + " in " +
              file);
  }
  void operationEntry(int line = 0) const {
    send(component, "Trace.h", "markProviderEntry", ordinary, 336, rule);
    send(component, "Trace.h", "markProviderEntry", ordinary, 337, "ENTERING: " + place(line));
  }
  void operationExit(int line = 0) const {
    send(component, "Trace.h", "markProviderExit", ordinary, 348, "EXITING: " + place(line));
    send(component, "Trace.h", "markProviderExit", ordinary, 349, rule);
  }

 private:
  std::string place(int line) const { return function + "() in " + file + " [Line: " + std::to_string(line) + ']'; }
  void line_(int level, int line, const std::string& text) const { send(component, file, function, level, line, text); }

  // To the log first, then to the trace.
  static void send(const std::string& component, const std::string& file, const std::string& function, int level,
                   int line, const std::string& text) {
    const std::string cut = text.substr(0, 511);
    TWLog::TWMessageBuffer buffer;
    buffer << cut.c_str();
    TWLog::TWLogger::logLevelMessage(function.c_str(), file.c_str(), line, component, level, nullptr, 0, 0,
                                     TWLog::str(buffer));
    buffer << cut.c_str();
    TWLog::TWLogger::traceLevelMessage(function.c_str(), file.c_str(), line, component, level, nullptr, 0, 0,
                                       TWLog::str(buffer));
  }
};

Reporter memberReporter(const char* function) {
  return {"Tarnwick.IPObjectFactory", "IPConfigObjectFactory", function};
}

// One operation: the request, and the status that it threads through its calls.
class Answer {
 public:
  Answer(const Request& request, const ModelCall& call)
      : request_(request),
        call_(call),
        operation_{request.unit->component, request.unit->file, request.unit->prefix + nameOf(request.operation)} {}

  CMPIStatus ofInstanceUnit() {
    switch (request_.operation) {
      case Operation::GetInstance:
        return getInstance();
      case Operation::EnumInstances:
        return enumInstances();
      case Operation::EnumInstanceNames:
        return enumInstanceNames();
      case Operation::ModifyInstance:
        return request_.unit->acceptsModify ? modifyInstance() : notSupported();
      default:
        return stub();
    }
  }

  CMPIStatus ofAssociationUnit() {
    association_ = &associationOf(request_.unit->className);
    switch (request_.operation) {
      case Operation::GetInstance:
        return getAssociation();
      case Operation::EnumInstances:
        return enumAssociations();
      case Operation::EnumInstanceNames:
        return enumAssociationNames();
      case Operation::Associators:
        return associators();
      case Operation::AssociatorNames:
        return associatorNames();
      case Operation::References:
        return references();
      case Operation::ReferenceNames:
        return referenceNames();
      case Operation::ModifyInstance:
        return notSupported();
      default:
        return stub();
    }
  }

 private:
  using Instances = std::vector<CMPIInstance*>;

  static CMPIStatus notSupported() { return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr}; }

  CMPIStatus stub() const {
    const bool cleansUp =
        request_.operation == Operation::Cleanup || request_.operation == Operation::AssociationCleanup;
    return cleansUp ? CMPIStatus{CMPI_RC_OK, nullptr} : notSupported();
  }

  void traceToBroker(int level, const char* text) {
    CMTraceMessage(call_.broker, level, "CompositeIPConfigProvider", text, nullptr);
  }

  // The namespace of the request and the system's name as host.
  void rehome(CMPIObjectPath* path, CMPIStatus* status) {
    if (usable(path)) {
      const std::string nameSpace = nameSpaceOf(call_.path, status);
      CMSetNameSpace(path, nameSpace.c_str());
      CMSetHostname(path, QV::getSystemName().c_str());
    }
  }

  CMPIObjectPath* pathOf(const CMPIInstance* instance, CMPIStatus* status) {
    return usable(instance) ? CMGetObjectPath(instance, status) : nullptr;
  }

  void setText(CMPIInstance* instance, const Constant& property) {
    if (usable(instance)) {
      CMSetProperty(instance, property.name, property.value, CMPI_chars);
    }
  }

  void setReference(CMPIInstance* instance, const char* name, const CMPIObjectPath* path) {
    if (usable(instance) && usable(path)) {
      CMSetProperty(instance, name, &path, CMPI_ref);
    }
  }

  // Making and reading composite instances

  CMPIInstance* make(const Composite& composite, const char** properties, CMPIStatus* status) {
    const Reporter report = memberReporter(composite.make);
    report.entering();
    report.message("Calling CMNewObjectPath");
    const std::string first = nameSpaceOf(call_.path, status);
    CMPIObjectPath* path = CMNewObjectPath(call_.broker, first.c_str(), composite.name, nullptr);
    if (!usable(path)) {
      report.exiting();
      return nullptr;
    }
    report.message("Calling CMSetNameSpace");
    const std::string nameSpace = nameSpaceOf(call_.path, status);
    report.variable("namesp", nameSpace);
    report.variable("systemname", QV::getSystemName());
    CMSetNameSpace(path, nameSpace.c_str());
    report.message("Calling CMSetHostname");
    CMSetHostname(path, QV::getSystemName().c_str());
    report.message("Calling CMNewInstance");
    CMPIInstance* instance = CMNewInstance(call_.broker, path, nullptr);
    if (usable(instance)) {
      std::vector<const char*> keys = composite.keys;
      CMSetPropertyFilter(instance, properties, keys.data());
      for (const Constant& constant : composite.constants) {
        setText(instance, constant);
      }
    }
    report.exiting();
    return instance;
  }

  bool isChosen(const Composite& composite, const CMPIInstance* underlying, CMPIStatus* status) {
    switch (composite.chosen) {
      case Chosen::All:
        return true;
      case Chosen::OfProcessor:
        return textProperty(underlying, "SystemCreationClassName", status, status) == "YRNQV_SPComputerSystem";
      case Chosen::ByIdentifier: {
        const auto fields = fieldsOf(textProperty(underlying, "InstanceID", status, status));
        return fields.size() == composite.identifierFields && QV::textEqual(fields[0].c_str(), "BMC");
      }
    }
    return false;
  }

  // What the computer system has besides copies; false if the array that probes for memory cannot be made.
  bool addSystemProperties(const Reporter& report, const CMPIInstance* underlying, CMPIInstance* composite,
                           CMPIUint16 index, CMPIStatus* status) {
    if (!CMNewArray(call_.broker, 4, CMPI_uint16, status)) {
      const char* text = "Create Array for Property Dedicated failed.";
      status->rc = CMPI_RC_ERR_FAILED;
      status->msg = CMNewString(call_.broker, text, nullptr);
      traceToBroker(2, text);
      return false;
    }
    report.message(" CMGetProperty Dedicated");
    if (usable(underlying)) {
      const CMPIData dedicated = CMGetProperty(underlying, "Dedicated", status);
      if (!flaggedNull(dedicated) && CMIsArray(dedicated) && usable(dedicated.value.array)) {
        CMGetArrayCount(dedicated.value.array, status);
        report.message(" CMSetProperty Dedicated");
        if (usable(composite)) {
          CMSetProperty(composite, "Dedicated", &dedicated.value.array, CMPI_uint16A);
        }
      }
    }
    report.message(" CMSetProperty Index");
    if (usable(composite)) {
      CMSetProperty(composite, "Index", &index, CMPI_uint16);
    }
    return true;
  }

  bool getAll(const std::string& className, const Composite& composite, const char** properties, Instances& out,
              CMPIStatus* status) {
    const Reporter report = memberReporter(composite.getAll);
    report.entering();
    if (!QV::textEqual(className.c_str(), composite.name)) {
      traceToBroker(2, "***No instance found***");
      return false;
    }
    const bool isSystem = composite.chosen == Chosen::All;
    CMPIObjectPath* path = CMNewObjectPath(call_.broker, "root/yrnse", composite.underlying, status);
    CMPIEnumeration* enumeration = CBEnumInstances(call_.broker, call_.context, path, nullptr, status);
    if (status->rc == CMPI_RC_OK && usable(enumeration)) {
      CMPIUint16 index = 0;
      while (CMHasNext(enumeration, status)) {
        const CMPIData item = instanceIn(CMGetNext(enumeration, status));
        if (!isChosen(composite, item.value.inst, status)) {
          continue;
        }
        CMPIInstance* instance = make(composite, properties, status);
        for (const Property& property : composite.copied) {
          QV::mapProperty(item, instance, property.name, property.type, status);
        }
        if (composite.last) {
          setText(instance, *composite.last);
        }
        if (isSystem && !addSystemProperties(report, item.value.inst, instance, ++index, status)) {
          return false;
        }
        out.push_back(instance);
        if (isSystem) {
          report.message(" Insatance done");
          traceToBroker(1, "***Returning One IPConfig instance***");
        }
      }
    }
    if (composite.identifierFields == 3) {
      report.operationExit();
    } else {
      report.exiting();
    }
    return true;
  }

  // An item of another type carries no instance, whatever it points to.
  static CMPIData instanceIn(const CMPIData& data) {
    CMPIData item = {CMPI_instance, CMPI_nullValue, {}};
    if (data.type == CMPI_instance && usable(data.value.inst)) {
      item.state = CMPI_goodValue;
      item.value.inst = data.value.inst;
    }
    return item;
  }

  // The instance side of the composite classes

  bool readOwnClass(const char** properties, Instances& out) {
    const std::string className = classNameOf(call_.path, &status_);
    return getAll(className, compositeOf(request_.unit->className), properties, out, &status_);
  }

  CMPIStatus getInstance() {
    operation_.operationEntry(207);
    if (CMGetKeyCount(call_.path, &status_) == 0) {
      const char* text = "At least one key should be passed";
      status_.rc = CMPI_RC_ERR_FAILED;
      status_.msg = CMNewString(call_.broker, text, nullptr);
      traceToBroker(1, text);
      CMReturnDone(call_.result);
      operation_.operationExit(265);
      return status_;
    }
    Instances instances;
    if (!readOwnClass(call_.properties, instances)) {
      return status_;
    }
    returnMatching(instances, false);
    CMReturnDone(call_.result);
    operation_.operationExit(265);
    return status_;
  }

  void returnMatching(const Instances& instances, bool flag) {
    for (CMPIInstance* instance : instances) {
      if (!usable(instance)) {
        continue;
      }
      if (QV::isObjPathsEqual(call_.path, CMGetObjectPath(instance, &status_), flag)) {
        CMReturnInstance(call_.result, instance);
        return;
      }
    }
  }

  CMPIStatus enumInstances() {
    operation_.operationEntry(75);
    Instances instances;
    if (!readOwnClass(call_.properties, instances)) {
      operation_.operationExit(98);
      return status_;
    }
    for (const CMPIInstance* instance : instances) {
      CMReturnInstance(call_.result, instance);
    }
    CMReturnDone(call_.result);
    operation_.operationExit(114);
    return status_;
  }

  CMPIStatus enumInstanceNames() {
    operation_.operationEntry(137);
    Instances instances;
    if (!readOwnClass(nullptr, instances)) {
      return status_;
    }
    for (const CMPIInstance* instance : instances) {
      returnRehomedPath(pathOf(instance, &status_));
    }
    CMReturnDone(call_.result);
    operation_.operationExit(184);
    return status_;
  }

  // A path that cannot be followed is no answer.
  void returnRehomedPath(CMPIObjectPath* path) {
    if (usable(path)) {
      rehome(path, &status_);
      CMReturnObjectPath(call_.result, path);
    }
  }

  // Changes

  static std::string renderingOf(const CMPIObjectPath* path) {
    return usable(path) ? charactersOf(CMObjectPathToString(path, nullptr), nullptr) : "";
  }

  CMPIStatus modifyInstance() {
    operation_.operationEntry();
    if (!usable(call_.instance)) {
      const char* text = "Modify instance Passed is NULL";
      CMNewString(call_.broker, text, nullptr);
      operation_.message(text, ordinary, 353);
      CMReturnDone(call_.result);
      return {CMPI_RC_ERR_FAILED, nullptr};
    }
    operation_.variable("objstring", renderingOf(call_.path), 320);
    operation_.variable("modifyobjstring", renderingOf(pathOf(call_.instance, nullptr)), 330);
    const bool carriedOut = request_.unit->className == Classes::endpoint        ? modifyEndpoint()
                            : request_.unit->className == Classes::staticSetting ? modifyStaticSetting()
                                                                                 : modifyAccessPoint();
    if (!carriedOut) {
      return status_;
    }
    CMReturnDone(call_.result);
    return {status_.rc, nullptr};
  }

  bool modifyEndpoint() {
    const Reporter report = memberReporter("modifyIPProtocolendptCMPIInstance");
    report.entering(458);
    const std::string name = textIn(CMGetKey(call_.path, "Name", &status_), nullptr);
    report.variable("IpName", name, 469);
    const std::string address = textProperty(call_.instance, "IPv4Address", &status_, nullptr);
    report.variable("Ipv4Address", address, 476);
    const std::string mask = textProperty(call_.instance, "SubnetMask", &status_, nullptr);
    report.variable("Ipv4SubnetMask", mask, 483);
    const bool carriedOut = write(name, address, mask);
    report.exiting(487);
    return carriedOut;
  }

  bool modifyStaticSetting() {
    const Reporter report = memberReporter("modifyStaticIPCMPIInstance");
    report.entering(408);
    const CMPIData identifier = CMGetKey(call_.path, "InstanceID", &status_);
    if (!flaggedNull(identifier)) {
      const auto fields = fieldsOf(textIn(identifier, nullptr));
      const std::string address = textProperty(call_.instance, "IPv4Address", &status_, nullptr);
      report.variable("Ipv4Address", address, 431);
      const std::string mask = textProperty(call_.instance, "SubnetMask", &status_, nullptr);
      report.variable("Ipv4SubnetMask", mask, 438);
      write(fields.size() == 2 ? fields[1] : "", address, mask);
    }
    report.exiting(444);
    return true;
  }

  static bool modifyAccessPoint() {
    const Reporter report = memberReporter("modifyRemoteSAPCMPIInstance");
    report.entering(310);
    report.exiting(394);
    return true;
  }

  static bool write(const std::string& name, std::string address, std::string mask) {
    const Reporter report = memberReporter("executeModifyInstance");
    report.entering(498);
    bool hasNodes = true;
    try {
      QV::Instrumentation instrumentation;
      instrumentation.selectNode(static_cast<QV::NodeLexicon::NodeType>(29));
      hasNodes = instrumentation;
      if (hasNodes && reachNode(instrumentation, name, report)) {
        report.variable("name", name, 517);
        if (!address.empty()) {
          instrumentation.setProperty(static_cast<QV::NodeLexicon::Properties>(25), address);
        }
        if (!mask.empty()) {
          instrumentation.setProperty(static_cast<QV::NodeLexicon::Properties>(26), mask);
        }
      }
    } catch (const std::exception&) {
      report.message("Caught Exception : ", failure, 533);
      return false;
    }
    report.exiting(536);
    return hasNodes;
  }

  static bool reachNode(QV::Instrumentation& instrumentation, const std::string& name, const Reporter& report) {
    std::string nodeName;
    while (instrumentation) {
      if (!instrumentation.getProperty(static_cast<QV::NodeLexicon::Properties>(108), nodeName)) {
        continue;
      }
      report.variable("name", nodeName, 514);
      if (nodeName == name) {
        return true;
      }
      ++instrumentation;
    }
    return false;
  }

  // The instance side of the associations

  CMPIStatus getAssociation() {
    operation_.operationEntry();
    if (CMGetKeyCount(call_.path, &status_) == 0) {
      operation_.message("At least one key should be passed", failure);
    } else {
      Instances instances;
      if (build(call_.properties, instances) == 0) {
        returnMatching(instances, true);
      }
    }
    CMReturnDone(call_.result);
    operation_.operationExit();
    return status_;
  }

  CMPIStatus enumAssociations() {
    operation_.operationEntry();
    Instances instances;
    if (build(call_.properties, instances) == 0) {
      for (const CMPIInstance* instance : instances) {
        CMReturnInstance(call_.result, instance);
      }
    }
    CMReturnDone(call_.result);
    operation_.operationExit();
    return status_;
  }

  CMPIStatus enumAssociationNames() {
    operation_.operationEntry();
    Instances instances;
    if (build(nullptr, instances) == 0) {
      for (const CMPIInstance* instance : instances) {
        const CMPIObjectPath* path = pathOf(instance, &status_);
        if (usable(path)) {
          CMReturnObjectPath(call_.result, path);
        }
      }
    }
    CMReturnDone(call_.result);
    operation_.operationExit();
    return status_;
  }

  // The builders. A reaction that ends answers its result.

  std::optional<int> react(const Reporter& report, const Reaction& reaction) {
    if (!reaction.message.empty()) {
      report.message(reaction.message, failure, reaction.line);
    }
    return reaction.result;
  }

  bool readEnd(const char* className, Instances& out, CMPIStatus* status) {
    return getAll(className, compositeOf(className), nullptr, out, status);
  }

  int build(const char** properties, Instances& out) {
    const Reporter report = {operation_.component, operation_.file, association_->builder};
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    report.operationEntry(association_->entryLine);
    Instances outers;
    if (!readEnd(association_->outer, outers, &status)) {
      return *react(report, association_->outerFails);
    }
    for (const CMPIInstance* outer : outers) {
      if (!usable(outer)) {
        if (const auto result = react(report, association_->outerUnusable)) {
          return *result;
        }
        continue;
      }
      // An end without a path pairs with nothing.
      CMPIObjectPath* outerPath = CMGetObjectPath(outer, &status);
      if (!usable(outerPath)) {
        continue;
      }
      rehome(outerPath, &status);
      if (association_->ordered) {
        CMGetKey(outerPath, "InstanceID", &status);
      }
      Instances inners;
      if (!readEnd(association_->inner, inners, &status)) {
        if (const auto result = react(report, association_->innerFails)) {
          return *result;
        }
        continue;
      }
      for (const CMPIInstance* inner : inners) {
        if (const auto result = pair(report, outerPath, inner, properties, out, &status)) {
          return *result;
        }
      }
    }
    report.operationExit(association_->exitLine);
    return 0;
  }

  std::optional<int> pair(const Reporter& report, const CMPIObjectPath* outerPath, const CMPIInstance* inner,
                          const char** properties, Instances& out, CMPIStatus* status) {
    if (!usable(inner)) {
      return react(report, association_->innerUnusable);
    }
    CMPIObjectPath* innerPath = CMGetObjectPath(inner, status);
    if (!usable(innerPath)) {
      return std::nullopt;
    }
    rehome(innerPath, status);
    if (association_->ordered &&
        !holds(textIn(CMGetKey(innerPath, "InstanceID", status), status), association_->word)) {
      return std::nullopt;
    }
    const std::string nameSpace = nameSpaceOf(call_.path, status);
    CMPIObjectPath* path = CMNewObjectPath(call_.broker, nameSpace.c_str(), association_->name, status);
    if (!usable(path)) {
      return react(report, association_->pathUnmade);
    }
    rehome(path, status);
    const CMPIObjectPath* first = association_->firstHoldsOuter ? outerPath : innerPath;
    const CMPIObjectPath* second = association_->firstHoldsOuter ? innerPath : outerPath;
    if (association_->keysOnPath) {
      CMAddKey(path, association_->first, &first, CMPI_ref);
      CMAddKey(path, association_->second, &second, CMPI_ref);
    }
    CMPIInstance* instance = CMNewInstance(call_.broker, path, nullptr);
    if (!usable(instance)) {
      if (association_->appendsUnmade) {
        out.push_back(instance);
      }
      return std::nullopt;
    }
    const char* keys[] = {association_->first, association_->second, nullptr};
    CMSetPropertyFilter(instance, properties, keys);
    setReference(instance, association_->first, first);
    setReference(instance, association_->second, second);
    if (association_->flags) {
      setFlags(instance, innerPath);
    }
    out.push_back(instance);
    return std::nullopt;
  }

  static void setFlags(CMPIInstance* instance, const CMPIObjectPath* sequencePath) {
    CMPIStatus read = {CMPI_RC_OK, nullptr};
    CMPIStatus conversion = {CMPI_RC_OK, nullptr};
    const std::string identifier = textIn(CMGetKey(sequencePath, "InstanceID", &read), &conversion);
    const bool known = read.rc == CMPI_RC_OK && conversion.rc == CMPI_RC_OK;
    const CMPIUint16 inForce = known && fieldsOf(identifier).size() > 2 ? 2 : 1;
    const CMPIUint16 next = 3;
    CMSetProperty(instance, "IsDefault", &inForce, CMPI_uint16);
    CMSetProperty(instance, "IsCurrent", &inForce, CMPI_uint16);
    CMSetProperty(instance, "IsNext", &next, CMPI_uint16);
  }

  // The association side

  std::string farEndOf(const char* associationClass) {
    const Reporter report = memberReporter("get_assoc_targetClass_Name");
    report.entering();
    const std::string source = classNameOf(call_.path, &status_);
    for (const FarEnd& row : farEnds) {
      if (QV::textEqual(source.c_str(), row.source) && QV::textEqual(associationClass, row.association)) {
        report.message(row.target);
        return row.target;
      }
    }
    report.message("Target Assoc Class Not Found");
    report.variable("sourceclass", source);
    return "";
  }

  CMPIObjectPath* resolve(const char* associationClass) {
    const Reporter report = memberReporter("get_assoc_targetClass_ObjectPath");
    report.entering();
    const std::string target = farEndOf(associationClass);
    report.variable("targetName", target);
    if (QV::textEqual(target.c_str(), "")) {
      return nullptr;
    }
    report.message(" Creating CMNewObjectPath");
    const std::string nameSpace = nameSpaceOf(call_.path, &status_);
    CMPIObjectPath* path = CMNewObjectPath(call_.broker, nameSpace.c_str(), target.c_str(), &status_);
    rehome(path, &status_);
    return path;
  }

  CMPIStatus breakOff(const char* message) {
    operation_.message(message, failure);
    return status_;
  }

  void open() {
    operation_.operationEntry();
    if (association_->ordered) {
      sourceIdentifier_ = textIn(CMGetKey(call_.path, "InstanceID", &status_), &status_);
    }
  }

  bool isAssociated(const CMPIInstance* farInstance, bool farIsSequence, const char* word) {
    if (!association_->ordered) {
      return true;
    }
    const std::string identifier = textProperty(farInstance, "InstanceID", &status_, &status_);
    if (identifier.empty()) {
      return false;  // what bears no identifier belongs to nothing
    }
    return farIsSequence ? holds(identifier, sourceIdentifier_) && holds(identifier, word)
                         : holds(sourceIdentifier_, identifier);
  }

  CMPIStatus walk(const CMPIObjectPath* target, const char* word,
                  const std::function<void(CMPIInstance*, bool farIsEndA)>& visit) {
    const std::string className = classNameOf(target, &status_);
    const bool isEndA = className == association_->endA;
    if (isEndA || className == association_->endB) {
      Instances instances;
      if (!readEnd(isEndA ? association_->endA : association_->endB, instances, &status_)) {
        return status_;
      }
      for (CMPIInstance* instance : instances) {
        if (isAssociated(instance, isEndA, word)) {
          visit(instance, isEndA);
        }
      }
    }
    operation_.operationExit();
    return status_;
  }

  CMPIStatus associators() {
    open();
    const CMPIObjectPath* target = resolve(request_.associationClass);
    if (!usable(target)) {
      return breakOff("Object Path is NULL in Associators.");
    }
    return walk(target, association_->word,
                [&](const CMPIInstance* instance, bool) { CMReturnInstance(call_.result, instance); });
  }

  CMPIStatus associatorNames() {
    open();
    const CMPIObjectPath* target = resolve(request_.associationClass);
    if (!usable(target)) {
      return breakOff("Object Path is NULL in AssociatorNames.");
    }
    return walk(target, association_->word,
                [&](const CMPIInstance* instance, bool) { returnRehomedPath(pathOf(instance, &status_)); });
  }

  struct Reference {
    CMPIInstance* instance;
    bool hasBothEnds;
  };

  // Without a path to make it on there is no instance.
  Reference makeReference(const CMPIObjectPath* associationPath, const CMPIInstance* farInstance, bool farIsEndA) {
    CMPIInstance* instance = usable(associationPath) ? CMNewInstance(call_.broker, associationPath, &status_) : nullptr;
    CMPIObjectPath* farPath = pathOf(farInstance, &status_);
    rehome(farPath, &status_);
    setReference(instance, association_->propertyA, farIsEndA ? farPath : call_.path);
    setReference(instance, association_->propertyB, farIsEndA ? call_.path : farPath);
    return {instance, usable(farPath)};
  }

  CMPIStatus referTo(const char* word, const std::function<void(const Reference&)>& answer) {
    open();
    const CMPIObjectPath* target = resolve(association_->name);
    const std::string nameSpace = nameSpaceOf(call_.path, &status_);
    const CMPIObjectPath* associationPath =
        CMNewObjectPath(call_.broker, nameSpace.c_str(), association_->name, &status_);
    if (!usable(target)) {
      return breakOff("Object Path is NULL in References.");
    }
    return walk(target, word, [&](const CMPIInstance* farInstance, bool farIsEndA) {
      answer(makeReference(associationPath, farInstance, farIsEndA));
    });
  }

  CMPIStatus references() {
    return referTo(association_->word,
                   [&](const Reference& reference) { CMReturnInstance(call_.result, reference.instance); });
  }

  CMPIStatus referenceNames() {
    return referTo(association_->wordOfReferenceNames, [&](const Reference& reference) {
      // The name of a reference that lacks an end would name nothing.
      if (reference.hasBothEnds) {
        returnRehomedPath(pathOf(reference.instance, &status_));
      }
    });
  }

  const Request& request_;
  const ModelCall& call_;
  const Reporter operation_;
  const Association* association_ = nullptr;
  CMPIStatus status_ = {CMPI_RC_OK, nullptr};
  std::string sourceIdentifier_;
};

}  // namespace

CMPIStatus answerOfModel(const Request& request, const ModelCall& call) {
  Answer answer(request, call);
  return request.unit->createAssociationMI ? answer.ofAssociationUnit() : answer.ofInstanceUnit();
}

}  // namespace Testing
