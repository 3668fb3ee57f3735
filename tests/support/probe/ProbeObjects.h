// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <string>
#include <vector>

namespace Probe {

// The text that a modified TEST_Thing keeps until the provider is cleaned up.
std::string text();
void setText(const std::string& text);

// How many instances of TEST_Thing there are, two where nobody says.
void setThings(CMPIUint16 count);

// The instances of a class in the path's namespace: the things, one part, one link from the first thing to the part,
// one numbered, one machine; none of any other class.
std::vector<CMPIInstance*> instancesOf(const CMPIBroker* broker, const CMPIObjectPath* path);

CMPIObjectPath* thingPath(const CMPIBroker* broker, const char* nameSpace, const char* className, CMPIUint16 number);

// Whether both paths name the same object; hosts and namespaces do not count.
bool same(const CMPIObjectPath* one, const CMPIObjectPath* other);

}  // namespace Probe
