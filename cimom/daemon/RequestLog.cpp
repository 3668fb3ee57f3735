// SPDX-License-Identifier: Apache-2.0
#include "cimom/daemon/RequestLog.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <chrono>
#include <cstring>
#include <ctime>
#include <string>
#include <utility>

#include "ground/Printable.h"

namespace Cimom {
namespace {

constexpr mode_t fileMode = 0640;

// A subject of a client's making is not a line of any length.
constexpr std::size_t longestField = 512;

std::string now() {
  constexpr int second = 1000;
  const auto time = std::chrono::system_clock::now();
  const std::time_t seconds = std::chrono::system_clock::to_time_t(time);
  const auto milliseconds =
      static_cast<int>(std::chrono::duration_cast<std::chrono::milliseconds>(time.time_since_epoch()).count() % second);
  std::tm calendar{};
  gmtime_r(&seconds, &calendar);
  std::array<char, sizeof "2000-01-01T00:00:00"> text{};
  std::strftime(text.data(), text.size(), "%FT%T", &calendar);
  const std::string fraction = std::to_string(second + milliseconds);
  return std::string(text.data()) + "." + fraction.substr(1) + "Z";
}

// A field without blanks, "-" for none.
std::string field(const std::string& text) {
  std::string printed = Ground::printable(text.substr(0, longestField));
  for (char& character : printed) {
    character = character == ' ' ? '_' : character;
  }
  return printed.empty() ? "-" : printed;
}

}  // namespace

RequestLog::RequestLog(std::filesystem::path file) : file_(std::move(file)), descriptor_(open()) {}

void RequestLog::write(const Http::RequestRecord& record) {
  const std::string line = now() + " " + field(record.client) + " " + field(record.user) + " " +
                           std::to_string(record.status) + " " + std::to_string(record.duration.count()) + " " +
                           Ground::printable(record.subject.substr(0, longestField)) + "\n";
  const std::lock_guard lock(mutex_);
  // A disk that is full costs lines, and no request.
  [[maybe_unused]] const auto written = ::write(descriptor_.number(), line.data(), line.size());
}

void RequestLog::reopen() {
  Ground::Descriptor opened = open();
  const std::lock_guard lock(mutex_);
  descriptor_ = std::move(opened);
}

Ground::Descriptor RequestLog::open() const {
  Ground::Descriptor opened = file_ == "-" ? Ground::Descriptor(fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, 0))
                                           : Ground::Descriptor(file_, O_WRONLY | O_CREAT | O_APPEND, fileMode);
  if (!opened.isOpen()) {
    throw Http::ServerError("request-log: " + file_.string() + ": " + std::strerror(errno));
  }
  return opened;
}

}  // namespace Cimom
