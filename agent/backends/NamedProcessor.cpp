// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/NamedProcessor.h"

#include <utility>

namespace QV {

NamedProcessor::NamedProcessor(std::shared_ptr<BackEnd> processor, std::string name, std::string description)
    : processor_(std::move(processor)), name_(std::move(name)), description_(std::move(description)) {}

ManagementProcessor NamedProcessor::read() {
  ManagementProcessor processor = processor_->read();
  if (!name_.empty()) {
    processor.name = name_;
  }
  if (!description_.empty()) {
    processor.description = description_;
  }
  return processor;
}

InterfaceNames NamedProcessor::interfaceNames() { return processor_->interfaceNames(); }

void NamedProcessor::change(const std::string& interfaceName, const AddressChange& change) {
  processor_->change(interfaceName, change);
}

}  // namespace QV
