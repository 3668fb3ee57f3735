// SPDX-License-Identifier: Apache-2.0
// What QV::Instrumentation does: a cursor over the interfaces that a management processor had when it was set, which
// gathers the address and the mask of one change into one exchange with the processor. Their values are read when the
// first is asked for: a walk that looks for an interface by its name and changes it needs none.
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

  // Sends what is staged, asks the processor for its interfaces and stands on its first interface; past the end for any
  // other node type.
  void select(NodeLexicon::NodeType type);

  bool onNode() const { return position_ < names_.size(); }

  // Sends what is staged and moves on.
  void advance();

  // See Instrumentation::getProperty. What was written through this cursor reads as written once it has been sent: the
  // processor is read again.
  bool get(NodeLexicon::Properties property, std::string& value);

  // See Instrumentation::setProperty. An address waits for the mask that may follow; a mask completes the change and
  // sends it. A refused value or a failed exchange abandons the whole change: nothing of it is sent later.
  bool set(NodeLexicon::Properties property, const std::string& value);

  // Sends an address that still waits for its mask. Whether it is a host's under the mask that the interface has can be
  // told only now.
  void flush();

 private:
  void send(const AddressChange& change);
  // The interface that the cursor stands on; null where it has gone since the cursor was set.
  const NetworkInterface* current();

  std::shared_ptr<BackEnd> backEnd_;
  InterfaceNames names_;
  std::optional<std::vector<NetworkInterface>> interfaces_;
  std::size_t position_ = 0;
  std::optional<Ipv4Address> stagedAddress_;
};

}  // namespace QV
