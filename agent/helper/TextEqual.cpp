// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>

#include "ground/Names.h"

namespace QV {

bool textEqual(const char* a, const char* b) { return a && b && Ground::sameName(a, b); }

}  // namespace QV
