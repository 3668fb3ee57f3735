// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "cimom/http/HostNames.h"
#include "cimom/http/Message.h"

namespace Cimom::Http {

struct Refusal {
  unsigned status;
  std::string reason;
};

// Why a request is not to be looked at further, by its version and headers alone: where it ends is in doubt (RFC 9112,
// section 6), or it is meant for another host (section 3.2).
std::optional<Refusal> findFault(std::string_view version, const Headers& headers, const HostNames& names,
                                 const Address& arrivedAt);

}  // namespace Cimom::Http
