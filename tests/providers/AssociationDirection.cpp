// SPDX-License-Identifier: Apache-2.0
#include "tests/providers/AssociationDirection.h"

namespace Testing {

AssociationDirectionTest::AssociationDirectionTest() {
  attach(*std::get<0>(GetParam()).model);
  if (!model().pairsByIdentifier) {
    farNames = {"BMC:one:far", "BMC:two:far", "BMC:three:far"};
  } else if (farIsA()) {
    // Sequences that contain the setting and both kind words.
    farNames = {"BMC:eth0:static-dhcp", "BMC:eth0:dhcp-static", "BMC:eth0+eth1:static+dhcp"};
  } else {
    // Settings that the sequence contains.
    farNames = {"BMC:eth0", "BMC:eth", "BMC:e"};
  }
}

std::string AssociationDirectionTest::sourceName() const {
  if (!model().pairsByIdentifier) {
    return "source";
  }
  return farIsA() ? "BMC:eth0" : "BMC:eth0:static";
}

CMPIObjectPath* AssociationDirectionTest::source() {
  faults.upCallScripts.clear();
  add(farClass(), farNames);
  return clientPath(sourceClass(), sourceName());
}

Strings AssociationDirectionTest::farPaths(std::string (*rendering)(const std::string&, const std::string&)) const {
  Strings paths;
  for (const std::string& name : farNames) {
    paths.push_back(rendering(farClass(), name));
  }
  return paths;
}

std::string AssociationDirectionTest::sourceReference() const {
  return rendered(hostOfReference(requestHost()), requestNameSpace, sourceClass(), sourceName());
}

Strings AssociationDirectionTest::sourceTiedToFarNames() const {
  Strings pairs;
  for (const std::string& path : farPaths(homedReference)) {
    pairs.push_back(sourceReference() + " -> " + path);
  }
  return pairs;
}

}  // namespace Testing
