// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cxxabi.h>

#include <exception>
#include <new>

#include "cimom/http/Reply.h"

namespace Cimom::Http {

// What the function answers, or why it does not. The end of the thread passes through.
template <typename Answer>
Response guarded(Answer answer) {
  try {
    try {
      return answer();
    } catch (const abi::__forced_unwind&) {
      throw;
    } catch (const std::bad_alloc&) {
      return overload("the server is out of memory");
    } catch (const std::exception& error) {
      return refusal(MHD_HTTP_INTERNAL_SERVER_ERROR, error.what());
    } catch (...) {
      return refusal(MHD_HTTP_INTERNAL_SERVER_ERROR, "the request failed");
    }
  } catch (const std::bad_alloc&) {
    return Response{MHD_HTTP_SERVICE_UNAVAILABLE, {}, {}};  // there is no memory even for the reason
  }
}

}  // namespace Cimom::Http
