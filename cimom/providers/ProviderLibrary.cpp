// SPDX-License-Identifier: Apache-2.0
#include "cimom/providers/ProviderLibrary.h"

#include <dlfcn.h>

#include <utility>

#include "cimom/model/Errors.h"

namespace Cimom {
namespace {

std::filesystem::path locate(const std::string& name, const std::vector<std::filesystem::path>& directories) {
  std::string searched;
  for (const auto& directory : directories) {
    const auto file = directory / name;
    std::error_code ignored;
    if (std::filesystem::exists(file, ignored)) {
      return std::filesystem::absolute(file);
    }
    searched += (searched.empty() ? "" : ", ") + directory.string();
  }
  throw StatusError(CMPI_RC_ERR_FAILED, name + " not found, " +
                                            (searched.empty() ? "no provider directory is configured"
                                                              : "provider directories searched: " + searched));
}

}  // namespace

ProviderLibrary::ProviderLibrary(const std::string& location, const std::vector<std::filesystem::path>& directories)
    : file_(locate("lib" + location + ".so", directories)) {
  // Local: a provider's symbols serve nobody but the provider, and no two libraries can meet in a name that both
  // define. Now: what a library lacks shows when it is loaded, not in the middle of a request.
  handle_ = dlopen(file_.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (!handle_) {
    throw StatusError(CMPI_RC_ERR_FAILED, "cannot load " + file_ + ": " + dlerror());
  }
}

ProviderLibrary::~ProviderLibrary() {
  if (handle_) {
    dlclose(handle_);
  }
}

ProviderLibrary::ProviderLibrary(ProviderLibrary&& other) noexcept
    : handle_(std::exchange(other.handle_, nullptr)), file_(std::move(other.file_)) {}

ProviderLibrary& ProviderLibrary::operator=(ProviderLibrary&& other) noexcept {
  std::swap(handle_, other.handle_);
  std::swap(file_, other.file_);
  return *this;
}

void* ProviderLibrary::symbol(const std::string& name) const {
  dlerror();
  void* found = dlsym(handle_, name.c_str());
  if (!found) {
    const char* reason = dlerror();
    throw StatusError(CMPI_RC_ERR_FAILED,
                      file_ + " has no function " + name + (reason ? std::string(": ") + reason : ""));
  }
  return found;
}

}  // namespace Cimom
