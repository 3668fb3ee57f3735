// SPDX-License-Identifier: Apache-2.0
// The factory's members by name: each read pair stands for its row of the model.
#include "factory/IPConfigObjectFactory.h"

#include "factory/CompositeInstances.h"
#include "factory/FactoryFrame.h"

namespace QV::IPConfigComposite {

const std::string loggerIPObjectFactory = "Tarnwick.IPObjectFactory";

#define IPCONFIG_DEFINE_PAIR(getAll, make, row)                                                                  \
  int IPConfigObjectFactory::getAll(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* ref, \
                                    const char* className, const char** properties, bool noFilter,               \
                                    std::vector<CMPIInstance*>& out, CMPIStatus* status) {                       \
    return readComposites(row, __func__, {broker, ref, properties, noFilter, status}, ctx, className, out);      \
  }                                                                                                              \
  CMPIInstance* IPConfigObjectFactory::make(const CMPIBroker* broker, const CMPIObjectPath* ref,                 \
                                            const char** properties, bool noFilter, CMPIStatus* status) {        \
    return makeComposite(row, __func__, {broker, ref, properties, noFilter, status});                            \
  }
IPCONFIG_COMPOSITE_CLASSES(IPCONFIG_DEFINE_PAIR)
#undef IPCONFIG_DEFINE_PAIR

void IPConfigObjectFactory::Tokenize(const std::string& text, std::vector<std::string>& tokens,
                                     const std::string& delimiters) {
  std::size_t start = text.find_first_not_of(delimiters);
  while (start != std::string::npos) {
    const std::size_t end = text.find_first_of(delimiters, start);
    tokens.push_back(text.substr(start, end - start));
    start = text.find_first_not_of(delimiters, end);
  }
}

}  // namespace QV::IPConfigComposite
