// A back end in a shared object of its own: a processor whose name is what the setting "name" says.
#include <stdexcept>

#include "agent/processor/BackEnd.h"

namespace {

class StandIn : public QV::BackEnd {
 public:
  explicit StandIn(std::string name) : name_(std::move(name)) {}
  QV::ManagementProcessor read() override { return {name_, "a stand-in", {}, {}}; }
  void change(const std::string&, const QV::AddressChange&) override {}

 private:
  const std::string name_;
};

}  // namespace

extern "C" __attribute__((visibility("default"))) QV::BackEnd* qvCreateBackEnd(const QV::BackEndSettings& settings) {
  const auto name = settings.find("name");
  if (name == settings.end()) {
    throw std::runtime_error("[ipmi] name is missing");
  }
  return new StandIn(name->second);
}
