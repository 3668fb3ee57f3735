// The management processor of this process: one back end, shared by the instrumentation's cursors and by the underlying
// provider, so that what a client writes is what the next read shows.
#pragma once

#include <memory>

#include "agent/processor/BackEnd.h"

namespace QV {

// The back end that agent.ini chooses, made on first use; that a processor is simulated is then reported, once. Throws
// std::runtime_error in words an administrator can act on where agent.ini is missing, broken or chooses none, or where
// the back end cannot be made; the next call tries again. Safe to call from several
// threads at once.
std::shared_ptr<BackEnd> sharedBackEnd();

}  // namespace QV
