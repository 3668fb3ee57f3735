// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "cimom/model/ClassDefinition.h"

namespace Cimom {

// A class as the MOF writes it: its own features only, its superclass by name.
struct ClassDeclaration {
  ClassDefinition own;
  std::string superclassName;
  std::string nameSpace;  // of the `#pragma namespace` before it; empty if there is none
};

// What a schema in the Managed Object Format (DSP0004, annex A) declares.
struct MofDeclarations {
  std::vector<ClassDeclaration> classes;
  std::vector<QualifierDeclaration> qualifiers;
  std::vector<std::string> namespaces;  // of `#pragma namespace`
};

// Reads classes, qualifier declarations and the pragmas include and namespace; other pragmas mean nothing here. A
// namespace holds up to the next one or the end of its file, for what is included in between too.
// A qualifier's declaration counts from there on, in later texts and files too. A file is read once for a namespace,
// however often it is named or included.
class MofReader {
 public:
  MofReader();

  // A file, or every *.mof under a directory in the order of their names.
  // Throws ConfigurationError "FILE:LINE: what is wrong".
  MofDeclarations readPath(const std::filesystem::path& fileOrDirectory);

  // `origin` is what messages call the text; files that it includes are looked for from the working directory.
  // Throws ConfigurationError "ORIGIN:LINE: what is wrong".
  MofDeclarations readText(std::string_view mof, const std::string& origin);

 private:
  friend class MofParser;

  void readFile(const std::filesystem::path& file, MofDeclarations& declarations, const std::string& nameSpace);

  Qualifiers qualifierTypes_;  // the declared qualifiers, with their types, defaults and flavors
  std::set<std::pair<std::filesystem::path, std::string>> files_;  // that were read, and for which namespace
};

}  // namespace Cimom
