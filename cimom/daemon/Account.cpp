// SPDX-License-Identifier: Apache-2.0
#include "cimom/daemon/Account.h"

#include <grp.h>
#include <pwd.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <stdexcept>

namespace Cimom {

void becomeUser(const std::string& name) {
  const passwd* account = getpwnam(name.c_str());
  if (!account) {
    throw std::runtime_error("user: there is no user \"" + name + "\"");
  }
  if (geteuid() == account->pw_uid) {
    return;
  }
  if (geteuid() != 0) {
    throw std::runtime_error("user: only root can become \"" + name + "\": start cimomd as root or as that user");
  }
  if (initgroups(name.c_str(), account->pw_gid) != 0 || setgid(account->pw_gid) != 0 || setuid(account->pw_uid) != 0) {
    throw std::runtime_error("user: cannot become \"" + name + "\": " + std::strerror(errno));
  }
}

}  // namespace Cimom
