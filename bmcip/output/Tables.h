// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

#include "bmcip/model/Change.h"
#include "bmcip/model/Processor.h"
#include "bmcip/output/Text.h"

namespace Bmcip {

// All of one server: a table for each kind, with a title.
std::string tablesOf(const Processor& processor, const Colours& colours);

// One row a server.
std::vector<std::string> fleetHeading();
std::vector<std::string> fleetRowOf(const Reading& reading);

// Before and after, or before and wanted where nobody knows more.
std::string tableOf(const ChangeReport& report, const Colours& colours);

}  // namespace Bmcip
