// SPDX-License-Identifier: Apache-2.0
#include "cimom/schema/Mof.h"

#include <algorithm>
#include <fstream>
#include <iterator>

#include "cimom/model/Errors.h"
#include "cimom/schema/MofParser.h"

namespace Cimom {
namespace {

namespace fs = std::filesystem;

// The standard qualifiers (DSP0004, 5.6.3) that a subclass does not inherit or that are not booleans written without
// a value. A schema need not declare them to use them.
Qualifiers standardQualifiers() {
  const auto restricted = [](const char* name, CMPIType type) { return Qualifier{name, Value::null(type), false}; };
  return {restricted("Abstract", CMPI_boolean),     restricted("Deprecated", CMPI_stringA),
          restricted("Experimental", CMPI_boolean), restricted("Override", CMPI_string),
          restricted("Terminal", CMPI_boolean),     restricted("Version", CMPI_string)};
}

std::vector<fs::path> mofFilesUnder(const fs::path& directory) {
  std::vector<fs::path> files;
  for (const auto& entry : fs::recursive_directory_iterator(directory)) {
    if (entry.is_regular_file() && entry.path().extension() == ".mof") {
      files.push_back(entry.path());
    }
  }
  if (files.empty()) {
    throw ConfigurationError(directory.string() + ": contains no *.mof file");
  }
  std::ranges::sort(files);
  return files;
}

}  // namespace

MofReader::MofReader() : qualifierTypes_(standardQualifiers()) {}

MofDeclarations MofReader::readPath(const fs::path& fileOrDirectory) {
  MofDeclarations declarations;
  try {
    if (fs::is_directory(fileOrDirectory)) {
      for (const fs::path& file : mofFilesUnder(fileOrDirectory)) {
        readFile(file, declarations, {});
      }
    } else {
      readFile(fileOrDirectory, declarations, {});
    }
  } catch (const fs::filesystem_error& error) {
    throw ConfigurationError(fileOrDirectory.string() + ": cannot be read: " + error.code().message());
  }
  return declarations;
}

MofDeclarations MofReader::readText(std::string_view mof, const std::string& origin) {
  MofDeclarations declarations;
  MofParser(*this, declarations, mof, origin, {}, {}).parse();
  return declarations;
}

void MofReader::readFile(const fs::path& file, MofDeclarations& declarations, const std::string& nameSpace) {
  const fs::path canonical = fs::canonical(file);
  if (fs::is_directory(canonical)) {
    throw fs::filesystem_error("include", file, std::make_error_code(std::errc::is_a_directory));
  }
  if (!files_.emplace(canonical, nameSpace).second) {
    return;
  }
  std::ifstream stream(canonical, std::ios::binary);
  if (!stream) {
    throw fs::filesystem_error("open", file, std::make_error_code(std::errc::permission_denied));
  }
  const std::string text{std::istreambuf_iterator<char>(stream), {}};
  MofParser(*this, declarations, text, file.string(), file.parent_path(), nameSpace).parse();
}

}  // namespace Cimom
