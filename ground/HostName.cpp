// SPDX-License-Identifier: Apache-2.0
#include "ground/HostName.h"

#include <unistd.h>

#include <array>

namespace Ground {

std::string hostName() {
  std::array<char, 256> name{};
  return ::gethostname(name.data(), name.size() - 1) == 0 && name[0] != '\0' ? name.data() : "localhost";
}

}  // namespace Ground
