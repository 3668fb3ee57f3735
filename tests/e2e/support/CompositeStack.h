#ifndef TESTS_E2E_SUPPORT_COMPOSITESTACK_H_
#define TESTS_E2E_SUPPORT_COMPOSITESTACK_H_

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "tests/e2e/support/Cimomd.h"
#include "tests/e2e/support/Wbem.h"
#include "tests/support/TemporaryDirectory.h"

namespace Testing {

/// The whole product as it is installed: cimomd with the product's classes and registration, the composite and the
/// underlying provider, and an agent.ini of its own. The managed system is called managed.example.
class CompositeStack {
 public:
  /// @param processor the sections of agent.ini that say how the management processor is reached
  /// @param logThreshold the least level that reaches log()
  explicit CompositeStack(const std::string& processor, int logThreshold = 6000);

  /// The options with which cimomd serves the product.
  static std::vector<std::string> options();

  Cimomd& cimomd() { return *cimomd_; }

  /// Where it listens for the objects of a namespace: "http://127.0.0.1:PORT/NAMESPACE:OBJECT".
  std::string url(const std::string& object, const std::string& nameSpace = "root/cimv2") const {
    return cimomd_->url(object, nameSpace);
  }

  /// Runs wbemcli; a space is what `operation` is split at.
  Completed wbemcli(const std::string& operation, const std::string& object, const std::vector<std::string>& more = {},
                    const std::string& nameSpace = "root/cimv2") const;

  /// What a wbemcli that must succeed answers: paths as they are printed; paths without host and namespace; instances.
  std::vector<std::string> paths(const std::string& operation, const std::string& object,
                                 const std::string& nameSpace = "root/cimv2") const;
  std::vector<std::string> names(const std::string& operation, const std::string& object,
                                 const std::string& nameSpace = "root/cimv2") const;
  std::vector<Printed> instances(const std::string& operation, const std::string& object,
                                 const std::string& properties = {}, const std::string& nameSpace = "root/cimv2") const;

  /// The properties that have a value of the one instance that GetInstance answers.
  std::map<std::string, std::string> get(const std::string& object, const std::string& nameSpace = "root/cimv2") const;

  /// ModifyInstance of "Name=value,..." pairs, which must succeed.
  void modify(const std::string& object, const std::string& values) const;

  /// What a wbemcli that must fail says.
  std::string failure(const std::string& operation, const std::string& object,
                      const std::vector<std::string>& more = {}, const std::string& nameSpace = "root/cimv2") const;

  std::string log() const;

  const TemporaryDirectory& directory() const { return directory_; }

 private:
  TemporaryDirectory directory_;
  std::unique_ptr<Cimomd> cimomd_;
};

/// The content of a file; empty where there is none.
std::string contentOf(const std::filesystem::path& file);

/// Sections of agent.ini for a simulated management processor, in its factory state where the file is not there yet.
std::string simulatedProcessor(const std::filesystem::path& state);

}  // namespace Testing

#endif  // TESTS_E2E_SUPPORT_COMPOSITESTACK_H_
