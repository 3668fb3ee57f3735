// SPDX-License-Identifier: Apache-2.0
// An enumeration of as many instances as one likes: what a client sends, and the management processor that answers.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace Testing {

// "eth1", "eth2", ...
std::string interfaceName(int number);

// An agent.ini for the simulated management processor of a state file, whose two channels filter what is not a failure.
std::string quietAgent(const std::string& stateFile);

// The state of a simulated management processor with that many interfaces.
std::string stateOf(int interfaces);

// EnumerateInstances in root/cimv2: the body and the header fields of the request, and how many instances an answer
// has.
std::string enumerationOf(const std::string& className);
std::vector<std::pair<std::string, std::string>> enumerationHeaders();
int instancesIn(const std::string& answer);

}  // namespace Testing
