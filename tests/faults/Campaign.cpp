// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Campaign.h"

#include <sys/mman.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <iomanip>
#include <memory>
#include <ostream>
#include <stdexcept>

#include "tests/faults/Allocations.h"

namespace Testing {

namespace {

constexpr const char* verdictNames[verdictCount] = {"held", "wrong", "leaked", "crashed"};
constexpr unsigned secondsForAPoint = 20;

std::string failureOf(const Point& point, const Finding& finding) {
  return std::string(verdictNames[static_cast<int>(finding.verdict)]) + ' ' + point.name() + ": " + finding.detail;
}

// What a process leaves behind, whatever becomes of it.
struct Progress {
  std::size_t next;  // the point that is under way
  std::size_t counts[faultCount][verdictCount];
};

// Its share of the points, carried out by one process after the other: each goes on after the point where the one
// before crashed.
class Worker {
 public:
  Worker(const std::vector<Point>& points, std::size_t first, std::size_t step,
         const std::function<Finding(const Point&)>& carryOutOne)
      : carryOutOne_(carryOutOne) {
    for (std::size_t i = first; i < points.size(); i += step) {
      points_.push_back(&points[i]);
    }
    void* memory = ::mmap(nullptr, sizeof(Progress), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    if (memory == MAP_FAILED) {
      throw std::runtime_error("no shared memory for the campaign");
    }
    progress_ = new (memory) Progress{};
    failures_ = std::tmpfile();
    if (!failures_) {
      throw std::runtime_error("no temporary file for the campaign");
    }
  }
  ~Worker() {
    ::munmap(progress_, sizeof(Progress));
    std::fclose(failures_);
  }
  Worker(const Worker&) = delete;
  Worker& operator=(const Worker&) = delete;

  bool isAt(pid_t process) const { return process == process_; }

  // Starts a process for what is left; false if nothing is.
  bool start() {
    if (progress_->next >= points_.size()) {
      return false;
    }
    process_ = ::fork();
    if (process_ < 0) {
      throw std::runtime_error("no process for the campaign");
    }
    if (process_ == 0) {
      work();
    }
    return true;
  }

  // Counts what the process ended with.
  void ended(int status) {
    process_ = -1;
    if (WIFEXITED(status) && WEXITSTATUS(status) == 0) {
      return;
    }
    const Point& point = *points_[std::min(progress_->next, points_.size() - 1)];
    const std::string how = WIFSIGNALED(status) && WTERMSIG(status) == SIGALRM ? "does not end"
                            : WIFSIGNALED(status) ? std::string("ends with ") + ::strsignal(WTERMSIG(status))
                                                  : "ends the process, status " + std::to_string(WEXITSTATUS(status));
    count(point, {Verdict::Crashed, how});
    ++progress_->next;
  }

  void addTo(Report& report) {
    Report own;
    std::memcpy(own.counts, progress_->counts, sizeof own.counts);
    std::rewind(failures_);
    std::string text;
    char buffer[4096];
    while (const std::size_t size = std::fread(buffer, 1, sizeof buffer, failures_)) {
      text.append(buffer, size);
    }
    for (std::size_t begin = 0; begin < text.size();) {
      const std::size_t end = text.find('\0', begin);
      own.failures.push_back(text.substr(begin, end - begin));
      begin = end + 1;
    }
    report.add(own);
  }

 private:
  void count(const Point& point, const Finding& finding) {
    ++progress_->counts[static_cast<int>(point.fault)][static_cast<int>(finding.verdict)];
    if (finding.verdict != Verdict::Held) {
      const std::string text = failureOf(point, finding);
      // With its zero, by which it is found again.
      if (std::fwrite(text.c_str(), text.size() + 1, 1, failures_) != 1 || std::fflush(failures_) != 0) {
        std::perror("the campaign's temporary file");
      }
    }
  }

  // What escapes a point ends the process; it must not unwind into who forked it.
  [[noreturn]] void work() noexcept {
    for (; progress_->next < points_.size(); ++progress_->next) {
      ::alarm(secondsForAPoint);
      const Point& point = *points_[progress_->next];
      count(point, carryOutOne_(point));
    }
    ::alarm(0);
    if (sanitizerFindsLeaks()) {
      count(*points_.back(), {Verdict::Leaked, "this point or one before it"});
    }
    ::_exit(0);
  }

  const std::function<Finding(const Point&)>& carryOutOne_;
  std::vector<const Point*> points_;
  Progress* progress_;
  std::FILE* failures_;
  pid_t process_ = -1;
};

}  // namespace

std::string Point::name() const { return request->name() + '@' + std::to_string(call) + ':' + nameOf(fault); }

std::vector<Point> points(const std::string& part) {
  std::vector<Point> all;
  for (const Request& request : requests()) {
    if (request.name().find(part) == std::string::npos) {
      continue;
    }
    std::size_t number = 0;
    for (const RecordedCall& call : record(Who::Product, request)) {
      ++number;
      for (const Fault fault : call.faults) {
        all.push_back({&request, number, call.key, fault});
      }
    }
  }
  return all;
}

Point pointOf(const std::string& name) {
  const std::size_t at = name.rfind('@');
  const std::size_t colon = name.rfind(':');
  if (at == std::string::npos || colon == std::string::npos || colon < at) {
    throw std::invalid_argument("\"" + name + "\" is no point: must be REQUEST@CALL:FAULT");
  }
  for (const Point& point : points(name.substr(0, at))) {
    if (point.name() == name) {
      return point;
    }
  }
  throw std::invalid_argument("there is no point \"" + name + "\"");
}

std::vector<Point> share(const std::vector<Point>& all, std::size_t n) {
  std::vector<Point> chosen;
  for (std::size_t i = n / 2; i < all.size(); i += n) {
    chosen.push_back(all[i]);
  }
  return chosen;
}

Finding check(const Point& point) {
  const RunResult product = run(Who::Product, *point.request, point.key, point.fault);
  if (!product.violations.empty()) {
    return {Verdict::Wrong, product.violations.front()};
  }
  if (product.leaked != 0) {
    return {Verdict::Leaked, std::to_string(product.leaked) + " blocks"};
  }
  if (!product.fired) {
    return {Verdict::Wrong, "the call is not made a second time"};
  }
  const RunResult model = run(Who::Model, *point.request, point.key, point.fault);
  if (!model.fired) {
    return {Verdict::Wrong, "the model makes no such call"};
  }
  if (const auto found = difference(product.outcome, model.outcome)) {
    return {Verdict::Wrong, *found};
  }
  return {};
}

std::size_t Report::tried() const {
  std::size_t sum = 0;
  for (const auto& row : counts) {
    for (const std::size_t count : row) {
      sum += count;
    }
  }
  return sum;
}

std::size_t Report::failed() const {
  std::size_t held = 0;
  for (const auto& row : counts) {
    held += row[static_cast<int>(Verdict::Held)];
  }
  return tried() - held;
}

void Report::add(const Report& other) {
  for (int fault = 0; fault < faultCount; ++fault) {
    for (int verdict = 0; verdict < verdictCount; ++verdict) {
      counts[fault][verdict] += other.counts[fault][verdict];
    }
  }
  failures.insert(failures.end(), other.failures.begin(), other.failures.end());
}

std::ostream& operator<<(std::ostream& stream, const Report& report) {
  constexpr int nameWidth = 20;
  constexpr int width = 9;
  constexpr Verdict columns[] = {Verdict::Crashed, Verdict::Leaked, Verdict::Wrong, Verdict::Held};
  stream << std::left << std::setw(nameWidth) << "fault" << std::right << std::setw(width) << "points";
  for (const Verdict verdict : columns) {
    stream << std::setw(width) << verdictNames[static_cast<int>(verdict)];
  }
  stream << '\n';
  std::size_t sums[verdictCount] = {};
  for (int fault = 0; fault < faultCount; ++fault) {
    std::size_t sum = 0;
    for (int verdict = 0; verdict < verdictCount; ++verdict) {
      sum += report.counts[fault][verdict];
      sums[verdict] += report.counts[fault][verdict];
    }
    if (sum == 0) {
      continue;
    }
    stream << std::left << std::setw(nameWidth) << nameOf(static_cast<Fault>(fault)) << std::right << std::setw(width)
           << sum;
    for (const Verdict verdict : columns) {
      stream << std::setw(width) << report.counts[fault][static_cast<int>(verdict)];
    }
    stream << '\n';
  }
  stream << std::left << std::setw(nameWidth) << "all" << std::right << std::setw(width) << report.tried();
  for (const Verdict verdict : columns) {
    stream << std::setw(width) << sums[static_cast<int>(verdict)];
  }
  return stream << '\n';
}

Report carryOut(const std::vector<Point>& points, unsigned processes,
                const std::function<Finding(const Point&)>& carryOutOne) {
  std::vector<std::unique_ptr<Worker>> workers;
  unsigned running = 0;
  for (unsigned i = 0; i < processes; ++i) {
    workers.push_back(std::make_unique<Worker>(points, i, processes, carryOutOne));
    running += workers.back()->start() ? 1 : 0;
  }
  while (running > 0) {
    int status = 0;
    const pid_t process = ::waitpid(-1, &status, 0);
    if (process < 0) {
      throw std::runtime_error("the campaign lost its processes");
    }
    for (const auto& worker : workers) {
      if (worker->isAt(process)) {
        worker->ended(status);
        running -= worker->start() ? 0 : 1;
      }
    }
  }
  Report report;
  for (const auto& worker : workers) {
    worker->addTo(report);
  }
  return report;
}

}  // namespace Testing
