#include "cimom/http/Message.h"

#include <strings.h>

#include <algorithm>

namespace Cimom::Http {

const std::string* Headers::find(std::string_view name) const {
  const auto field = std::find_if(fields_.begin(), fields_.end(), [name](const auto& candidate) {
    return candidate.first.size() == name.size() && strncasecmp(candidate.first.data(), name.data(), name.size()) == 0;
  });
  return field == fields_.end() ? nullptr : &field->second;
}

}  // namespace Cimom::Http
