// SPDX-License-Identifier: Apache-2.0
// The operations of DSP0200 that bmcip needs, as messages and back.
#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "bmcip/client/Transport.h"
#include "cimom/cimxml/Request.h"

namespace Bmcip {

using Cimom::CimXml::Instance;
using Cimom::CimXml::ObjectName;

Call enumerateInstances(const std::string& nameSpace, const std::string& className);
Call enumerateInstanceNames(const std::string& nameSpace, const std::string& className);
Call associatorNames(const std::string& nameSpace, const ObjectName& source, const std::string& association);

// ModifyInstance of these properties, which are strings, and of no other.
using TextValues = std::vector<std::pair<std::string, std::string>>;
Call modifyInstance(const std::string& nameSpace, const ObjectName& path, const TextValues& values);

// What a reply's message holds: instances with their paths, names, or nothing. Throw Failure: of the kind NotServed or
// Error where the object manager refused the operation, of the kind Malformed where the message is no such reply.
std::vector<Instance> readInstances(std::string_view message);
std::vector<ObjectName> readNames(std::string_view message);
void readNothing(std::string_view message);

// The text of a property or of a key; empty if it has no value. An array's elements come with commas between them.
std::string textOf(const Instance& instance, std::string_view property);
std::string keyOf(const ObjectName& name, std::string_view key);

// A name as its class and keys, whatever their order and the place: equal for equal objects.
std::string identityOf(const ObjectName& name);

}  // namespace Bmcip
