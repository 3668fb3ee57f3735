// SPDX-License-Identifier: Apache-2.0
// The documented JSON (docs/bmcip.schema.json): one object, on one line.
#pragma once

#include <string>

#include "bmcip/model/Change.h"
#include "bmcip/model/Graph.h"
#include "bmcip/model/Processor.h"

namespace Bmcip {

std::string jsonOf(const Reading& reading);
std::string jsonOf(const ChangeReport& report);
std::string jsonOf(const Graph& graph, const Server& server);

// What a look saw that the one before did not; a value that is not there is empty.
struct Event {
  std::string time;  // RFC 3339
  std::string server;
  std::string what;
  std::string before;
  std::string after;
};
std::string jsonOf(const Event& event);

}  // namespace Bmcip
