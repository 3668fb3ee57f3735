// A back end in a shared object of its own: a processor whose name is what the setting "name" says.
#include "agent/processor/BackEnd.h"
#include "ground/Settings.h"

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
  const Ground::Settings reader("agent.ini, [ipmi]", settings);
  for (const auto& [key, value] : settings) {
    if (key != "name") {
      reader.refuse(key, value, "unknown");
    }
  }
  return new StandIn(reader.required("name"));
}
