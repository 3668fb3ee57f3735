// SPDX-License-Identifier: Apache-2.0
// log_cost LINES: sends that many lines, as the providers' frames are, through the trace channel of the agent.ini that
// the environment names. Under callgrind the lines after the first are counted and dumped as "lines".
#include <valgrind/callgrind.h>

#include <string>

#include "tests/agent/log/FrameLines.h"

int main(int, char** arguments) {
  Testing::sendFrameLines(1);
  CALLGRIND_ZERO_STATS;
  Testing::sendFrameLines(std::stoi(arguments[1]));
  CALLGRIND_DUMP_STATS_AT("lines");
}
