// SPDX-License-Identifier: Apache-2.0
// A management processor under the name and description that the administrator gave it.
#pragma once

#include <memory>
#include <string>

#include "agent/processor/BackEnd.h"

namespace QV {

class NamedProcessor : public BackEnd {
 public:
  // An empty name or description leaves the processor's own in place.
  NamedProcessor(std::shared_ptr<BackEnd> processor, std::string name, std::string description);

  ManagementProcessor read() override;
  InterfaceNames interfaceNames() override;
  void change(const std::string& interfaceName, const AddressChange& change) override;

 private:
  const std::shared_ptr<BackEnd> processor_;
  const std::string name_;
  const std::string description_;
};

}  // namespace QV
