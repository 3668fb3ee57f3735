// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>

#include <cstring>

#include "ground/Names.h"

namespace QV {

// Nearly all that are equal are spelled alike.
bool textEqual(const char* a, const char* b) { return a && b && (std::strcmp(a, b) == 0 || Ground::sameName(a, b)); }

}  // namespace QV
