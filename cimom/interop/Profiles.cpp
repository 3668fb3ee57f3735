// SPDX-License-Identifier: Apache-2.0
#include "cimom/interop/Profiles.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <set>

#include "cimom/model/Errors.h"
#include "ground/IniFile.h"

namespace Cimom {
namespace {

struct Key {
  const char* name;
  std::string Profile::*field;
};

constexpr Key keys[] = {
    {"version", &Profile::version}, {"description", &Profile::description}, {"central-class", &Profile::centralClass}};

void take(std::vector<Profile>& profiles, const Ground::IniEntry& entry) {
  if (entry.section.empty()) {
    throw ConfigurationError("key " + entry.key + " stands before the first [profile]");
  }
  if (profiles.empty() || profiles.back().name != entry.section) {
    if (std::ranges::find(profiles, entry.section, &Profile::name) != profiles.end()) {
      throw ConfigurationError("duplicate profile [" + entry.section + "]");
    }
    profiles.push_back({entry.section, {}, {}, {}, {}});
  }
  Profile& profile = profiles.back();
  if (entry.key == "references") {
    profile.references.push_back(entry.value);
    return;
  }
  const auto* const key = std::ranges::find_if(keys, [&](const Key& one) { return entry.key == one.name; });
  if (key == std::end(keys)) {
    throw ConfigurationError("unknown key " + entry.key +
                             ": must be version, description, central-class or references");
  }
  std::string& field = profile.*(key->field);
  if (!field.empty()) {
    throw ConfigurationError("duplicate key " + entry.key);
  }
  field = entry.value;
}

void readFile(const std::filesystem::path& file, std::vector<Profile>& profiles) {
  std::ifstream text(file);
  if (!text.is_open()) {
    throw ConfigurationError(file.string() + ": " + std::strerror(errno));
  }
  try {
    Ground::readIni(text, file.string(), [&](const Ground::IniEntry& entry) { take(profiles, entry); });
  } catch (const std::runtime_error& error) {
    throw ConfigurationError(error.what());
  }
}

void check(const std::filesystem::path& origin, const std::vector<Profile>& profiles) {
  for (const Profile& profile : profiles) {
    for (const Key& key : keys) {
      if ((profile.*(key.field)).empty()) {
        throw ConfigurationError(origin.string() + ": profile [" + profile.name + "] has no key " + key.name);
      }
    }
    for (const std::string& reference : profile.references) {
      if (std::ranges::find(profiles, reference, &Profile::name) == profiles.end()) {
        throw ConfigurationError(origin.string() + ": profile [" + profile.name + "] references the unknown profile [" +
                                 reference + "]");
      }
    }
  }
}

}  // namespace

std::vector<Profile> readProfiles(const std::filesystem::path& fileOrDirectory) {
  std::vector<Profile> profiles;
  if (!std::filesystem::is_directory(fileOrDirectory)) {
    readFile(fileOrDirectory, profiles);
  } else {
    std::set<std::filesystem::path> files;
    for (const auto& entry : std::filesystem::directory_iterator(fileOrDirectory)) {
      if (entry.path().extension() == ".profiles") {
        files.insert(entry.path());
      }
    }
    for (const auto& file : files) {
      readFile(file, profiles);
    }
  }
  check(fileOrDirectory, profiles);
  return profiles;
}

}  // namespace Cimom
