// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace Cimom {

// Gives up the rights of root for those of a user, its groups included; nothing where the process runs as that user
// already. To be called while there are no other threads that matter. Throws std::runtime_error.
void becomeUser(const std::string& name);

}  // namespace Cimom
