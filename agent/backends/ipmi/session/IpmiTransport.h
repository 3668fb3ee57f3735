// SPDX-License-Identifier: Apache-2.0
// How requests reach the management processor and answers come back: one at a time, in the manner of IPMI.
#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>
#include <vector>

namespace QV::Ipmi {

// The network functions that requests use (IPMI 2.0, table 5-1).
enum class NetworkFunction : std::uint8_t { Application = 0x06, Transport = 0x0C };

struct IpmiRequest {
  NetworkFunction networkFunction;
  std::uint8_t command;
  std::vector<std::uint8_t> data;
};

struct IpmiResponse {
  std::uint8_t completionCode;     // 0x00: done
  std::vector<std::uint8_t> data;  // what follows the completion code
  bool late = false;               // the request may have been sent again before this answer came
};

// Any failure of an exchange, in words an administrator can act on.
class IpmiError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// A request went out and no answer came: whether it took effect is unknown.
class ConnectionLost : public IpmiError {
 public:
  using IpmiError::IpmiError;
};

// A request was not sent: the processor cannot be reached, or the operation's time is over.
class NotSent : public IpmiError {
 public:
  using IpmiError::IpmiError;
};

// The processor answered that it does not do what it is asked.
class Refused : public IpmiError {
 public:
  using IpmiError::IpmiError;
};

// What may happen to a request whose answer fails to come because a held session broke.
enum class Repetition {
  Allowed,   // a new session is opened and the request sent once more: reads, and writes that may be done twice
  Forbidden  // the caller must learn of it: ConnectionLost
};

class IpmiTransport {
 public:
  virtual ~IpmiTransport() = default;

  // Sends a request and waits for its answer, whatever its completion code. Throws ConnectionLost or NotSent.
  virtual IpmiResponse send(const IpmiRequest& request, Repetition repetition) = 0;

  // What follows puts the processor in order after a failure and gets a little time of its own where the operation's is
  // over: nobody may be waiting any more, but a lock that is left behind shuts everybody out.
  virtual void beginCleanup() = 0;
};

}  // namespace QV::Ipmi
