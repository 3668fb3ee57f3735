// SPDX-License-Identifier: Apache-2.0
// Stands between the back end and libfreeipmi, where a request is a command and its answer a completion code and data:
// what is refused or cut there cannot be refused or cut on the wire, which is encrypted. The session below is real.
#pragma once

#include <cstdint>

namespace Testing {

struct CommandFault {
  enum class Kind {
    Refused,       // the BMC does not do it and answers with a completion code
    LostBefore,    // the BMC does not do it, and no answer comes
    LostAfter,     // the BMC does it, and no answer comes
    CutToNothing,  // the BMC does it; of its answer there is the command's number,
    CutToCode,     // the completion code too,
    CutByOne       // or all but the last byte
  };
  Kind kind;
  std::uint8_t completionCode = 0;
};

// Once, to the command of that number, counted from now; those that the calling thread sends are not counted.
void disturbCommand(unsigned number, const CommandFault& fault);

// Nothing more is disturbed; whether something was.
bool undisturbCommands();

// Whether the BMC is one that has no set-in-progress lock, for every thread but the calling one.
void withoutLock(bool without);

// The commands since the last disturbCommand().
unsigned commandsSent();

}  // namespace Testing
