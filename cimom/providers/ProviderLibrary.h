// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace Cimom {

// A provider's shared object, loaded as long as this lives.
class ProviderLibrary {
 public:
  ProviderLibrary() = default;
  // Loads the first lib<location>.so along the directories.
  // Throws StatusError CMPI_RC_ERR_FAILED with the library's name and what the loader says.
  ProviderLibrary(const std::string& location, const std::vector<std::filesystem::path>& directories);
  ~ProviderLibrary();
  ProviderLibrary(ProviderLibrary&& other) noexcept;
  ProviderLibrary& operator=(ProviderLibrary&& other) noexcept;

  explicit operator bool() const { return handle_; }

  // The function of that name.
  // Throws StatusError CMPI_RC_ERR_FAILED with the library's name and what the loader says.
  template <typename Function>
  Function* function(const std::string& name) const {
    return reinterpret_cast<Function*>(symbol(name));
  }

  // Leaves the library loaded for the life of the process.
  void keep() { handle_ = nullptr; }

 private:
  void* symbol(const std::string& name) const;

  void* handle_ = nullptr;
  std::string file_;
};

}  // namespace Cimom
