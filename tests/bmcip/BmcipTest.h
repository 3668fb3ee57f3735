// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "cimom/http/Server.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

// Runs bmcip with a home of its own, in which nothing is configured.
class BmcipTest : public testing::Test {
 protected:
  Completed bmcip(const std::vector<std::string>& arguments) const;
  Process start(const std::vector<std::string>& arguments) const;

  // The last line of what it says on the standard error.
  static std::string lastLine(const std::string& text);

  // That each line is an object of docs/bmcip.schema.json; the test is skipped where nothing can check that.
  void expectSchemaOf(const std::string& lines) const;

  // Added to the test's own environment.
  Environment environment_;
  const TemporaryDirectory directory_;

 private:
  Environment environment() const;
};

// The same with cimomd and a simulated processor in its factory state, which BMCIP_URL names.
class BmcipStackTest : public BmcipTest {
 protected:
  BmcipStackTest();

  std::string url() const;

  // What the simulated processor has now: the text of its state.
  std::string state() const { return readFile(directory_ / "processor.json"); }

  CompositeStack stack_{simulatedProcessor(directory_ / "processor.json")};
};

// An object manager that answers with recorded replies.
class RecordedServer {
 public:
  // @param directory below tests/bmcip/replies
  explicit RecordedServer(const std::string& directory);

  std::string url() const { return "http://127.0.0.1:" + std::to_string(server_.port()); }

  // From now on that file answers what is asked for a class or a method.
  void answer(const std::string& question, const std::string& file) { files_[question] = file; }
  // The message is altered before it is sent.
  void alter(std::function<void(std::string& message)> alteration) { alteration_ = std::move(alteration); }

  // The requests' bodies, in order, once they are answered.
  const std::vector<std::string>& requests() const { return requests_; }

 private:
  Cimom::Http::Response respond(const Cimom::Http::Request& request);

  const std::string directory_;
  std::map<std::string, std::string> files_;
  std::function<void(std::string&)> alteration_;
  std::mutex mutex_;
  std::vector<std::string> requests_;
  Cimom::Http::Server server_;
};

}  // namespace Testing
