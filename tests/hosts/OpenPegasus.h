#pragma once

#include "tests/hosts/ObjectManager.h"

namespace Testing {

class OpenPegasus : public ObjectManager {
 public:
  OpenPegasus(std::string prefix, int processes) : ObjectManager(std::move(prefix), processes) {}

  // By disabling their modules.
  bool unloadProviders() override;
  void allowProviders() override;
  bool answersWithoutAClass() const override { return true; }
  bool answersRequestsThatItLost() const override { return true; }
  std::string program() const override { return "cimserver"; }
  std::string title() const override { return "OpenPegasus"; }

 protected:
  std::vector<std::string> parts() const override;
  std::vector<std::string> programs() const override;
  Environment environment() const override;
  void prepare() override;
  std::vector<std::string> installing() const override;
  std::vector<std::string> removing() const override;
  std::vector<std::string> upgrading() const override;
  std::vector<std::string> registeringByCommand() const override;
  std::vector<std::string> takingOutByCommand() const override;
};

}  // namespace Testing
