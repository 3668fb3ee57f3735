#pragma once

#include "tests/hosts/ObjectManager.h"

namespace Testing {

class Sfcb : public ObjectManager {
 public:
  Sfcb(std::string prefix, int processes) : ObjectManager(std::move(prefix), processes) {}

  // By leaving them idle, for less time than the minute that sfcb gives them by itself.
  bool unloadProviders() override;
  void allowProviders() override;
  std::string diagnostics() const override;
  bool answersWithoutAClass() const override { return false; }
  bool answersRequestsThatItLost() const override { return false; }
  std::string program() const override { return "sfcbd"; }
  std::string title() const override { return "sfcb"; }

 protected:
  std::vector<std::string> parts() const override;
  std::vector<std::string> programs() const override;
  std::map<std::string, std::string> differences() const override;
  void prepare() override;
  std::vector<std::string> installing() const override;
  std::vector<std::string> removing() const override;
  std::vector<std::string> upgrading() const override;
  std::vector<std::string> registeringByCommand() const override;
  std::vector<std::string> takingOutByCommand() const override;

 private:
  std::string configuration() const;
};

}  // namespace Testing
