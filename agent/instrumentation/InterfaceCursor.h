// SPDX-License-Identifier: Apache-2.0
// What QV::Instrumentation does: a cursor over the interfaces of a management processor as they were when it was set,
// which gathers the address and the mask of one change into one exchange with the processor.
#pragma once

#include <QV/Instrumentation.h>

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "agent/processor/BackEnd.h"

namespace QV {

class InterfaceCursor {
 public:
  explicit InterfaceCursor(std::shared_ptr<BackEnd> backEnd) : backEnd_(std::move(backEnd)) {}

  // Sends what is staged, reads the processor and stands on its first interface; past the end for any other node type.
  void select(NodeLexicon::NodeType type);

  bool onNode() const { return position_ < interfaces_.size(); }

  // Sends what is staged and moves on.
  void advance();

  // See Instrumentation::getProperty. What was written through this cursor reads as written once it has been sent.
  bool get(NodeLexicon::Properties property, std::string& value);

  // See Instrumentation::setProperty. An address waits for the mask that may follow; a mask completes the change and
  // sends it. A refused value or a failed exchange abandons the whole change: nothing of it is sent later.
  bool set(NodeLexicon::Properties property, const std::string& value);

  // Sends an address that still waits for its mask. Whether it is a host's under the mask can be told only now.
  void flush();

 private:
  void send(const AddressChange& change);

  std::shared_ptr<BackEnd> backEnd_;
  std::vector<NetworkInterface> interfaces_;
  std::size_t position_ = 0;
  std::optional<Ipv4Address> stagedAddress_;
};

}  // namespace QV
