// SPDX-License-Identifier: Apache-2.0
#include "bmcip/commands/Terminal.h"

#include <fcntl.h>
#include <termios.h>
#include <unistd.h>

#include <cerrno>
#include <iostream>

#include "bmcip/commands/Options.h"
#include "ground/Descriptor.h"

namespace Bmcip {
namespace {

// While one lives, the terminal does not show what is typed.
class HiddenInput {
 public:
  explicit HiddenInput(int terminal) : terminal_(terminal), known_(tcgetattr(terminal, &before_) == 0) {
    termios hidden = before_;
    hidden.c_lflag &= ~static_cast<tcflag_t>(ECHO);
    if (known_) {
      tcsetattr(terminal_, TCSAFLUSH, &hidden);
    }
  }
  ~HiddenInput() {
    if (known_) {
      tcsetattr(terminal_, TCSAFLUSH, &before_);
    }
  }
  HiddenInput(const HiddenInput&) = delete;
  HiddenInput& operator=(const HiddenInput&) = delete;

 private:
  const int terminal_;
  termios before_{};
  const bool known_;
};

void say(int terminal, const std::string& text) {
  if (::write(terminal, text.data(), text.size()) < 0) {
    throw UsageError("nothing can be asked at the terminal");
  }
}

}  // namespace

std::string askPassword(const std::string& user) {
  const Ground::Descriptor terminal("/dev/tty", O_RDWR);
  if (!terminal.isOpen()) {
    throw UsageError("the password of " + user +
                     " can only be asked for at a terminal: give --credentials FILE or --netrc");
  }
  say(terminal.number(), "Password of " + user + ": ");
  std::string password;
  {
    const HiddenInput hidden(terminal.number());
    for (char letter = 0;;) {
      const ssize_t size = ::read(terminal.number(), &letter, 1);
      if (size < 0 && errno == EINTR) {
        continue;
      }
      if (size <= 0 || letter == '\n') {
        break;
      }
      password += letter;
    }
  }
  say(terminal.number(), "\n");
  return password;
}

bool isConfirmed(const std::string& question) {
  if (isatty(STDIN_FILENO) != 1) {
    return false;
  }
  std::cerr << question << " [y/N] " << std::flush;
  std::string answer;
  std::getline(std::cin, answer);
  return answer == "y" || answer == "Y" || answer == "yes";
}

Progress::Progress(std::size_t total) : total_(total), isShown_(isatty(STDERR_FILENO) == 1) {}

void Progress::show(std::size_t done, std::size_t failed) {
  constexpr std::size_t width = 30;
  if (!isShown_) {
    return;
  }
  const std::size_t filled = total_ == 0 ? width : done * width / total_;
  std::string line = "\r[" + std::string(filled, '#') + std::string(width - filled, ' ') + "] " + std::to_string(done) +
                     "/" + std::to_string(total_) + " servers";
  if (failed > 0) {
    line += ", " + std::to_string(failed) + " failed";
  }
  if (line != last_) {
    std::cerr << line << std::flush;
    last_ = line;
  }
}

void Progress::clear() {
  if (!last_.empty()) {
    std::cerr << "\r\033[K" << std::flush;
    last_.clear();
  }
}

}  // namespace Bmcip
