#ifndef CIMOM_SCHEMA_MOF_H_
#define CIMOM_SCHEMA_MOF_H_

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/schema/ClassDefinition.h"

namespace Cimom {

/// A class as the MOF writes it: its own features only, its superclass by name.
struct ClassDeclaration {
  ClassDefinition own;
  std::string superclassName;
};

/// What a schema in the Managed Object Format (DSP0004, annex A) declares.
struct MofDeclarations {
  std::vector<ClassDeclaration> classes;
  std::vector<std::string> namespaces;  ///< of `#pragma namespace`
};

/// Reads classes, qualifier declarations and the pragmas include, namespace and locale; other pragmas mean nothing
/// here. Qualifiers and classes of a file are there for the files read after it. A file that is included or named
/// twice is read once.
class MofReader {
 public:
  MofReader();

  /// A file, or every *.mof under a directory.
  /// @throws ConfigurationError "FILE:LINE: what was expected"
  void readPath(const std::filesystem::path& fileOrDirectory);

  /// @param origin what messages call the text
  /// @throws ConfigurationError "ORIGIN:LINE: what was expected"
  void readText(std::string_view mof, const std::string& origin);

  const MofDeclarations& declarations() const { return declarations_; }

 private:
  friend class MofParser;

  void readFile(const std::filesystem::path& file);

  MofDeclarations declarations_;
  Qualifiers qualifierTypes_;  ///< declared qualifiers, with their defaults and flavors
  std::vector<std::filesystem::path> files_;
};

}  // namespace Cimom

#endif  // CIMOM_SCHEMA_MOF_H_
