// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/ProductSchema.h"

#include "Paths.h"

namespace Testing {

void loadProductSchema(Cimom::ObjectManager& manager, std::initializer_list<std::string_view> nameSpaces) {
  for (const char* file : {"CIM_Subset.mof", "CompositeIPConfig.mof", "UnderlyingIPConfig.mof"}) {
    manager.loadSchema(std::filesystem::path(SOURCE_DIR "/schema") / file);
  }
  for (const std::string_view nameSpace : nameSpaces) {
    manager.showSchema(nameSpace);
  }
}

}  // namespace Testing
