// SPDX-License-Identifier: Apache-2.0
// What bmcip does. Each returns the exit status, and throws Failure where a server that is asked alone does not answer.
#pragma once

#include "bmcip/client/Transport.h"
#include "bmcip/commands/Options.h"

namespace Bmcip {

int show(Transport& transport, const Options& options);
int set(Transport& transport, const Options& options);
int watch(Transport& transport, const Options& options);
int model(Transport& transport, const Options& options);

}  // namespace Bmcip
