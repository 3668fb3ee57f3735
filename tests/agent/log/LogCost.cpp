// SPDX-License-Identifier: Apache-2.0
// log_cost LINES: sends that many lines, as the providers' frames are, through the trace channel of the agent.ini that
// the environment names.
#include <string>

#include "tests/agent/log/FrameLines.h"

int main(int, char** arguments) { Testing::sendFrameLines(std::stoi(arguments[1])); }
