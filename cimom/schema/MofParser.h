// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

#include "cimom/schema/Mof.h"
#include "cimom/schema/MofLexer.h"

namespace Cimom {

// Parses one MOF text by recursive descent; the grammar is that of DSP0004, annex A, without instances.
class MofParser {
 public:
  // `directory` is where the text's relative includes are, `nameSpace` where its classes are until it says otherwise.
  MofParser(MofReader& reader, MofDeclarations& declarations, std::string_view mof, std::string origin,
            std::filesystem::path directory, std::string nameSpace);

  // Throws ConfigurationError "ORIGIN:LINE: what is wrong".
  void parse();

 private:
  void production();
  void pragma();
  void include(const std::string& file);
  void qualifierDeclaration();
  Qualifiers qualifierList();
  Qualifier qualifier();
  void flavors(Qualifier& target, std::string_view closing);
  void classDeclaration(Qualifiers qualifiers);
  void feature(ClassDefinition& definition);
  void method(ClassDefinition& definition, const std::string& name, CMPIType type, Qualifiers qualifiers);
  PropertyDeclaration parameter();
  void type(PropertyDeclaration& target);
  void arrayBounds(PropertyDeclaration& target);
  Value initializer(CMPIType type);
  Value constant(CMPIType type);

  void advance();
  bool accept(std::string_view punctuation);
  bool acceptKeyword(std::string_view keyword);
  void expect(std::string_view punctuation);
  std::string expectName(const char* what);
  std::string expectString(const char* what);
  [[noreturn]] void unexpected(const std::string& expected) const;
  [[noreturn]] void fail(const std::string& what) const { lexer_.fail(token_.line, what); }

  MofReader& reader_;
  MofDeclarations& declarations_;
  std::string origin_;
  std::filesystem::path directory_;
  std::string nameSpace_;
  MofLexer lexer_;
  MofToken token_;
};

}  // namespace Cimom
