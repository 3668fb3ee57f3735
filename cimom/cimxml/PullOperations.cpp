// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <utility>

#include "cimom/cimxml/Call.h"
#include "cimom/cimxml/OpenEnumerations.h"

namespace Cimom::CimXml {
namespace {

constexpr std::chrono::seconds defaultTimeout{60};
constexpr std::chrono::seconds longestTimeout{3600};

// A reply ends early, with one item at least, when it has become as long as this.
constexpr std::size_t longestReply = std::size_t{1} << 20U;

std::chrono::seconds timeoutOf(const Call& call) {
  const std::chrono::seconds asked(call.parameters.number("OperationTimeout").value_or(defaultTimeout.count()));
  if (asked > std::chrono::seconds::zero() && asked <= longestTimeout) {
    return asked;
  }
  throw OperationError(cimInvalidOperationTimeout, "parameter OperationTimeout must be a number from 1 to " +
                                                       std::to_string(longestTimeout.count()));
}

// What a server may leave out (DSP0200, 5.3.2.24.2) and this one does.
void refuseWhatIsNotOffered(const Call& call) {
  if (!call.parameters.text("FilterQuery").value_or("").empty() ||
      !call.parameters.text("FilterQueryLanguage").value_or("").empty()) {
    throw OperationError(cimFilteredEnumerationNotSupported, "filter queries are not supported");
  }
  if (call.parameters.flag("ContinueOnError", false)) {
    throw OperationError(cimContinuationOnErrorNotSupported, "continuation on error is not supported");
  }
}

// PARAMVALUE; one without a value is null.
void writeOutput(XmlWriter& xml, const char* name, const char* type, std::string_view value) {
  const auto scope = xml.element("PARAMVALUE", "NAME", name);
  xml.attribute("PARAMTYPE", type);
  if (!value.empty()) {
    xml.textElement("VALUE", value);
  }
}

// The next items; those that it takes are forgotten.
void writeItems(XmlWriter& xml, OpenEnumeration& enumeration, std::size_t maxCount) {
  const auto scope = xml.element("IRETURNVALUE");
  std::size_t bytes = 0;
  for (std::size_t count = 0; count < maxCount && enumeration.left() > 0 && bytes < longestReply; ++count) {
    const std::string item = std::move(enumeration.items[enumeration.next++]);
    bytes += item.size();
    xml.written(item);
  }
}

void writeEnd(XmlWriter& xml, const std::string& context) {
  writeOutput(xml, "EnumerationContext", "string", context);
  writeOutput(xml, "EndOfSequence", "boolean", context.empty() ? "TRUE" : "FALSE");
}

template <typename Find>
void open(Call& call, PulledItem item, Find find) {
  refuseWhatIsNotOffered(call);
  OpenEnumeration enumeration;
  enumeration.item = item;
  enumeration.user = call.manager.user;
  enumeration.timeout = timeoutOf(call);
  const std::size_t maxCount = call.parameters.number("MaxObjectCount").value_or(0);

  const Found found = find(call);
  for (const Cimom::Value& object : found.objects) {
    XmlWriter xml(XmlWriter::Prolog::None);
    ObjectWriter writer(xml, call.host, call.request.nameSpace, found.properties);
    if (item == PulledItem::InstanceWithPath) {
      writer.instanceWithPath(*object.embedded());
    } else {
      writer.instancePath(*object.path());
    }
    enumeration.items.push_back(xml.take());
  }

  writeItems(call.xml, enumeration, maxCount);
  const bool isComplete = enumeration.left() == 0;
  writeEnd(call.xml, isComplete ? "" : call.manager.openEnumerations.add(std::move(enumeration)));
}

void pull(Call& call, PulledItem item) {
  const std::string context = call.parameters.requiredText("EnumerationContext");
  const auto maxCount = call.parameters.number("MaxObjectCount");
  if (!maxCount) {
    throw OperationError(CMPI_RC_ERR_INVALID_PARAMETER, "parameter MaxObjectCount is missing");
  }
  OpenEnumerations& all = call.manager.openEnumerations;
  OpenEnumeration enumeration = all.take(context, call.manager.user, item);
  writeItems(call.xml, enumeration, *maxCount);
  const bool isComplete = enumeration.left() == 0;
  if (!isComplete) {
    all.putBack(context, std::move(enumeration));
  }
  writeEnd(call.xml, isComplete ? "" : context);
}

}  // namespace

void openEnumerateInstances(Call& call) { open(call, PulledItem::InstanceWithPath, findInstances); }

void openEnumerateInstancePaths(Call& call) { open(call, PulledItem::InstancePath, findInstanceNames); }

void openAssociatorInstances(Call& call) {
  open(call, PulledItem::InstanceWithPath, [](Call& one) { return findAssociators(one, "InstanceName"); });
}

void openAssociatorInstancePaths(Call& call) {
  open(call, PulledItem::InstancePath, [](Call& one) { return findAssociatorNames(one, "InstanceName"); });
}

void openReferenceInstances(Call& call) {
  open(call, PulledItem::InstanceWithPath, [](Call& one) { return findReferences(one, "InstanceName"); });
}

void openReferenceInstancePaths(Call& call) {
  open(call, PulledItem::InstancePath, [](Call& one) { return findReferenceNames(one, "InstanceName"); });
}

void pullInstancesWithPath(Call& call) { pull(call, PulledItem::InstanceWithPath); }

void pullInstancePaths(Call& call) { pull(call, PulledItem::InstancePath); }

void closeEnumeration(Call& call) {
  call.manager.openEnumerations.close(call.parameters.requiredText("EnumerationContext"), call.manager.user);
}

void enumerationCount(Call& call) {
  const std::size_t left =
      call.manager.openEnumerations.count(call.parameters.requiredText("EnumerationContext"), call.manager.user);
  const auto scope = call.xml.element("IRETURNVALUE");
  call.xml.textElement("VALUE", std::to_string(left));
}

}  // namespace Cimom::CimXml
