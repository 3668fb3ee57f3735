// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <microhttpd.h>

#include "cimom/http/Message.h"

namespace Cimom::Http {

// The response of a server that does not do what it was asked for: a line that says why, and the connection closes.
Response refusal(unsigned status, const std::string& reason);

// The same for what may be asked again a little later.
Response overload(const std::string& reason);

// Sends a response, whose body is held once: chunked where it is large and the client speaks HTTP/1.1.
MHD_Result send(MHD_Connection* connection, Response response, bool isHttp11);

}  // namespace Cimom::Http
