// SPDX-License-Identifier: Apache-2.0
#include "tests/support/system/SystemCalls.h"

#include <sys/ptrace.h>
#include <sys/syscall.h>
#include <sys/uio.h>
#include <sys/user.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <stdexcept>
#include <system_error>

#include "ground/Descriptor.h"

namespace Testing {
namespace {

// What no work asks for marks its beginning and its end.
constexpr long marker = SYS_getppid;
constexpr int threw = 1;

[[noreturn]] void fail(const char* what) { throw std::system_error(errno, std::generic_category(), what); }

// The register that holds the number of a call at its entry, and the one of its result at its exit.
struct Registers {
  user_regs_struct values{};

  explicit Registers(pid_t process) {
    if (::ptrace(PTRACE_GETREGS, process, nullptr, &values) != 0) {
      fail("PTRACE_GETREGS");
    }
  }
  void write(pid_t process) {
    if (::ptrace(PTRACE_SETREGS, process, nullptr, &values) != 0) {
      fail("PTRACE_SETREGS");
    }
  }
#if defined(__x86_64__)
  void setNumber(long number) { values.orig_rax = static_cast<unsigned long long>(number); }
  void setResult(long result) { values.rax = static_cast<unsigned long long>(result); }
#elif defined(__i386__)
  void setNumber(long number) { values.orig_eax = number; }
  void setResult(long result) { values.eax = result; }
#else
  [[noreturn]] void setNumber(long) { throw std::runtime_error("system calls can be failed on x86 alone"); }
  [[noreturn]] void setResult(long) { throw std::runtime_error("system calls can be failed on x86 alone"); }
#endif
};

__ptrace_syscall_info look(pid_t process) {
  __ptrace_syscall_info info{};
  if (::ptrace(PTRACE_GET_SYSCALL_INFO, process, sizeof info, &info) <= 0) {
    fail("PTRACE_GET_SYSCALL_INFO");
  }
  return info;
}

std::string textAt(pid_t process, std::uint64_t address) {
  std::string text(256, '\0');
  iovec here{text.data(), text.size()};
  iovec there{reinterpret_cast<void*>(address), text.size()};
  const ssize_t length = ::process_vm_readv(process, &here, 1, &there, 1, 0);
  return length <= 0 ? "" : std::string(text.c_str(), ::strnlen(text.c_str(), static_cast<std::size_t>(length)));
}

// Which argument of a call is the path that it is about.
std::optional<std::size_t> pathArgument(long number) {
  switch (number) {
#ifdef SYS_open
    case SYS_open:
    case SYS_unlink:
    case SYS_mkdir:
      return 0;
    case SYS_rename:
      return 1;
#endif
    case SYS_openat:
    case SYS_unlinkat:
    case SYS_mkdirat:
      return 1;
    case SYS_renameat:
    case SYS_renameat2:
      return 3;
    default:
      return std::nullopt;
  }
}

[[noreturn]] void doInChild(const std::function<void()>& work, const Ground::Descriptor& failures) {
  if (::ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0) {
    ::_exit(2);
  }
  ::raise(SIGSTOP);
  int status = 0;
  std::string failure;
  ::syscall(marker);
  try {
    work();
  } catch (const std::exception& error) {
    failure = error.what();
    status = threw;
  }
  ::syscall(marker);
  const ssize_t written = ::write(failures.number(), failure.data(), failure.size());
  ::_exit(written < 0 ? 2 : status);
}

// Follows the child from call to call.
class Tracer {
 public:
  Tracer(pid_t child, const std::optional<Intervention>& intervention) : child_(child), intervention_(intervention) {}

  int run(TracedWork& work) {
    int status = waitForStop();
    if (!WIFSTOPPED(status) ||
        ::ptrace(PTRACE_SETOPTIONS, child_, nullptr, PTRACE_O_TRACESYSGOOD | PTRACE_O_EXITKILL) != 0) {
      throw std::runtime_error("a child process cannot be traced here");
    }
    for (int signal = 0;;) {
      if (::ptrace(PTRACE_SYSCALL, child_, nullptr, signal) != 0) {
        fail("PTRACE_SYSCALL");
      }
      status = waitForStop();
      if (!WIFSTOPPED(status)) {
        return status;
      }
      signal = 0;
      if (WSTOPSIG(status) == (SIGTRAP | 0x80)) {
        if (!follow(work)) {
          work.killed = true;
          ::kill(child_, SIGKILL);
          return waitForStop();
        }
      } else if (WSTOPSIG(status) != SIGSTOP) {
        signal = WSTOPSIG(status);
      }
    }
  }

 private:
  int waitForStop() const {
    int status = 0;
    while (::waitpid(child_, &status, 0) < 0) {
      if (errno != EINTR) {
        fail("waitpid");
      }
    }
    return status;
  }

  // At the entry or the exit of a call; false if the process is to die here.
  bool follow(TracedWork& work) {
    const auto info = look(child_);
    if (info.op == PTRACE_SYSCALL_INFO_ENTRY) {
      return enter(info, work);
    }
    if (info.op == PTRACE_SYSCALL_INFO_EXIT && inCall_) {
      inCall_ = false;
      work.calls.back().result = static_cast<long>(info.exit.rval);
      if (failing_) {
        failing_ = false;
        Registers registers(child_);
        registers.setResult(-*intervention_->error);
        registers.write(child_);
        work.calls.back().result = -*intervention_->error;
      }
    }
    return true;
  }

  bool enter(const __ptrace_syscall_info& info, TracedWork& work) {
    const auto number = static_cast<long>(info.entry.nr);
    if (number == marker) {
      watching_ = !watching_;
      return true;
    }
    if (!watching_) {
      return true;
    }
    inCall_ = true;
    SystemCall call{number, {}, "", 0};
    std::copy(std::begin(info.entry.args), std::end(info.entry.args), call.arguments.begin());
    if (const auto argument = pathArgument(number)) {
      call.path = textAt(child_, call.arguments.at(*argument));
    }
    if (intervention_ && ++count_ == intervention_->call) {
      if (!intervention_->error) {
        return false;
      }
      failing_ = true;
      constexpr long none = -1;
      Registers registers(child_);
      registers.setNumber(none);
      registers.write(child_);
    }
    work.calls.push_back(call);
    return true;
  }

  const pid_t child_;
  const std::optional<Intervention> intervention_;
  unsigned count_ = 0;
  bool watching_ = false;
  bool inCall_ = false;
  bool failing_ = false;
};

}  // namespace

TracedWork traced(const std::function<void()>& work, const std::optional<Intervention>& intervention) {
  int pipe[2];
  if (::pipe2(pipe, O_CLOEXEC) != 0) {
    fail("pipe2");
  }
  const Ground::Descriptor failures(pipe[0]);
  Ground::Descriptor childsEnd(pipe[1]);
  const pid_t child = ::fork();
  if (child < 0) {
    fail("fork");
  }
  if (child == 0) {
    doInChild(work, childsEnd);
  }
  childsEnd = Ground::Descriptor();
  TracedWork result;
  const int status = Tracer(child, intervention).run(result);
  std::string text(4096, '\0');
  const ssize_t length = ::read(failures.number(), text.data(), text.size());
  if (WIFEXITED(status) && WEXITSTATUS(status) == threw) {
    result.failure = text.substr(0, static_cast<std::size_t>(std::max<ssize_t>(length, 0)));
  } else if (!result.killed && (!WIFEXITED(status) || WEXITSTATUS(status) != 0)) {
    throw std::runtime_error("the traced work ended with status " + std::to_string(status));
  }
  return result;
}

}  // namespace Testing
