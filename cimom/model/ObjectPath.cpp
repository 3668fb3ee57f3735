#include "cimom/model/ObjectPath.h"

namespace Cimom {

std::string ObjectPath::toString() const {
  std::string text;
  if (!host.empty()) text += "//" + host + "/";
  if (!nameSpace.empty()) text += nameSpace + ":";
  text += className;
  char separator = '.';
  for (const auto& [name, value] : keys) {
    text += separator + name + "=" + value.toString();
    separator = ',';
  }
  return text;
}

}  // namespace Cimom
