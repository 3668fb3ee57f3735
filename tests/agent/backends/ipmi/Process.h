// Programs that tests run beside themselves.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

namespace IpmiFixture {

// A running program with pipes on its standard input and output. The destructor closes its standard input, asks it to
// end and waits for it.
class Process {
 public:
  explicit Process(const std::vector<std::string>& command);
  ~Process();
  Process(const Process&) = delete;
  Process& operator=(const Process&) = delete;

  // Hands it a line on its standard input.
  void writeLine(const std::string& line);

  // The next line of its output, without the line feed; what there is where the output ends before.
  std::string readLine();

  // Everything it writes until it ends.
  std::string readAll();

 private:
  pid_t id_ = -1;
  int input_ = -1;
  int output_ = -1;
};

// What a program wrote to its standard output.
std::string outputOf(const std::vector<std::string>& command);

}  // namespace IpmiFixture
