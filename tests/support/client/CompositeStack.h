// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "tests/support/client/Cimomd.h"
#include "tests/support/client/WbemClient.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

// The whole product as it is installed: cimomd with the product's classes and registration, the composite and the
// underlying provider, and an agent.ini of its own. The managed system is called managed.example, and root/yrnse shows
// the host, too, whose objects must not reach the composite. That a processor is simulated is not logged.
class CompositeStack : public WbemClient {
 public:
  // @param processor the sections of agent.ini that say how the management processor is reached
  // @param logThreshold the least level that reaches log()
  // @param more options of cimomd
  explicit CompositeStack(const std::string& processor, int logThreshold = 6000,
                          const std::vector<std::string>& more = {});

  // Options with which cimomd checks no more than other object managers do.
  static std::vector<std::string> bare() { return {"--strictness", "bare"}; }

  // The options with which cimomd serves the product.
  static std::vector<std::string> options();

  Cimomd& cimomd() { return *cimomd_; }

  std::uint16_t port() const override { return cimomd_->port(); }

  std::string log() const;

  const TemporaryDirectory& directory() const { return directory_; }

 private:
  TemporaryDirectory directory_;
  std::unique_ptr<Cimomd> cimomd_;
};

// The content of a file; empty if there is none.
std::string contentOf(const std::filesystem::path& file);

// Sections of agent.ini for a simulated management processor, in its factory state where the file is not there yet.
std::string simulatedProcessor(const std::filesystem::path& state);

}  // namespace Testing
