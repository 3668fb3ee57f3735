#include "ground/Settings.h"

#include <stdexcept>

namespace Ground {

const std::string* Settings::find(const std::string& key) const {
  const auto entry = section_.find(key);
  return entry == section_.end() ? nullptr : &entry->second;
}

const std::string& Settings::required(const std::string& key) const {
  const std::string* value = find(key);
  if (!value || value->empty()) {
    refuse(key, "", "the key is missing and has no default");
  }
  return *value;
}

void Settings::text(const std::string& key, std::string& target) const {
  if (find(key)) {
    target = required(key);
  }
}

void Settings::absolutePath(const std::string& key, std::string& target) const {
  take(key, [&](const std::string& value) { target = parseAbsolutePath(value); });
}

void Settings::seconds(const std::string& key, std::chrono::milliseconds& target, std::chrono::milliseconds least,
                       std::chrono::milliseconds most) const {
  take(key, [&](const std::string& value) { target = parseSeconds(value, least, most); });
}

void Settings::take(const std::string& key, const std::function<void(const std::string&)>& use) const {
  const std::string* value = find(key);
  if (!value) {
    return;
  }
  try {
    use(*value);
  } catch (const std::invalid_argument& refusal) {
    refuse(key, *value, refusal.what());
  }
}

void Settings::refuse(const std::string& key, const std::string& value, const std::string& reason) const {
  throw RefusedSetting(place_, key, value, reason);
}

}  // namespace Ground
