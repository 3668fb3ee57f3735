// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cimom/model/Errors.h"
#include "cimom/schema/Mof.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::HasSubstr;
using testing::StartsWith;

// What the reader says of a text; empty if it accepts it.
std::string complaint(std::string_view mof) {
  try {
    MofReader().readText(mof, "text");
  } catch (const ConfigurationError& error) {
    return error.what();
  }
  return {};
}

TEST(MofErrorsTest, NameTheLineAndWhatWasExpected) {
  const struct {
    const char* mof;
    const char* says;
  } rows[] = {
      {"nonsense", "text:1: expected a class, a qualifier declaration or a pragma, not \"nonsense\""},
      {"class", "text:1: expected the class's name, not end of text"},
      {"class A", "text:1: expected \"{\", not end of text"},
      {"class A {\n}\n", "text:3: expected \";\", not end of text"},
      {"class A {\n string };", "text:2: expected the name of a property or method, not \"}\""},
      {"class A {\n\n unt16 P; };", "text:3: expected a known type, or \"REF\" after unt16, not \"P\""},
      {"class A { string P }", "text:1: expected \";\", not \"}\""},
      {"class A { string P[; };", "expected \"]\", not \";\""},
      {"class A { string P[99999999999]; };", "an array of 99999999999 elements is too large"},
      {"class A { string P; uint8 p; };", "duplicate A.p"},
      {"class A { uint8 P = 256; };", "expected uint8, not \"256\""},
      {"class A { uint8 P = -1; };", "expected uint8, not \"-1\""},
      {"class A { uint8 P = \"1\"; };", "expected uint8, not the string \"1\""},
      {"class A { boolean P = 1; };", "expected boolean, not \"1\""},
      {"class A { string P = ; };", "expected a value, not \";\""},
      {"class A { uint8 P[] = 1; };", "expected \"{\", not \"1\""},
      {"class A { uint8 P[] = {1 2}; };", "expected \"}\", not \"2\""},
      {"class A { datetime P = \"today\"; };", "not a CIM datetime: \"today\""},
      {"class A { uint64 P = 99999999999999999999; };", "is not a 64-bit number"},
      {"class A { sint64 P = -9223372036854775809; };", "is not a 64-bit number"},
      {"class A { uint8 P = 12x; };", "is not a 64-bit number"},
      {"class A { uint8 P = 09; };", "is not a 64-bit number"},
      {"class A { real64 P = 1.2.3; };", "\"1.2.3\" is not a number"},
      {"class A { char16 P = 'ab'; };", "'ab' must be one character"},
      {"class A { string P = \"abc\n\"; };", "text:1: unterminated string"},
      {"class A { string P = \"\\q\"; };", "unknown escape sequence"},
      {"class A { string P = \"\\xZZ\"; };", "unknown escape sequence"},
      {"class A { string P = \"\\", "unknown escape sequence"},
      {"\n/* never ends", "text:2: unterminated comment"},
      {"class A { string P; } ~", "text:1: unexpected character \"~\""},
      {"[Key, key] class A {};", "duplicate qualifier key"},
      {"[Key class A {};", "expected \"]\", not \"class\""},
      {"[Description(] class A {};", "expected a value, not \"]\""},
      {"[Key: Sometimes] class A {};", "expected a flavor, not \"Sometimes\""},
      {"[] class A {};", "expected a qualifier's name, not \"]\""},
      {"Qualifier : string;", "expected the qualifier's name, not \":\""},
      {"Qualifier A : string = null, Colour(red);", "expected \"Scope\" or \"Flavor\", not \"Colour\""},
      {"Qualifier A : uint8 = \"x\";", "expected uint8, not the string \"x\""},
      {"instance of A { P = 1; };", "text:1: instances are not supported: they come from providers"},
      {"class A as $a {};", "class aliases are not supported"},
      {"class A $a {};", "class aliases are not supported"},
      {"# include(\"x\")", "expected \"pragma\", not \"include\""},
      {"#pragma include(x)", "expected the pragma's argument in quotes, not \"x\""},
      {"\n#pragma include(\"no-such.mof\")", "text:2: \"no-such.mof\" cannot be included: No such file or directory"},
      {"\n#pragma include(\"/\")", "text:2: \"/\" cannot be included: Is a directory"},
      {"class A { char16 P = '\xF0\x9F\x98\x80'; };", "must be one character"},
      {"class A { uint32 M(string; };", "expected the parameter's name, not \";\""},
      {"class A { uint32 M(string a }", "expected \")\", not \"}\""},
  };
  for (const auto& row : rows) {
    EXPECT_THAT(complaint(row.mof), StartsWith("text:")) << row.mof;
    EXPECT_THAT(complaint(row.mof), HasSubstr(row.says)) << row.mof;
  }
}

TEST(MofErrorsTest, ATextCutAnywhereIsAcceptedOrRefusedAndNoMore) {
  const std::string whole = testSchema;
  int refused = 0;
  for (std::size_t length = 0; length < whole.size(); ++length) {
    refused += !complaint(whole.substr(0, length)).empty();
  }
  EXPECT_GT(refused, 1000);
}

TEST(MofErrorsTest, ATextWithABrokenByteAnywhereIsAcceptedOrRefusedAndNoMore) {
  const std::string whole = testSchema;
  for (const char wrong : {'\0', '"', '{', '\\', '\'', '\xFF', '['}) {
    for (std::size_t position = 0; position < whole.size(); position += 3) {
      std::string broken = whole;
      broken[position] = wrong;
      complaint(broken);
    }
  }
}

TEST(MofErrorsTest, AFileIsNamedWithItsPath) {
  const TemporaryDirectory directory;
  const auto read = [](const std::filesystem::path& path) -> std::string {
    try {
      MofReader().readPath(path);
    } catch (const ConfigurationError& error) {
      return error.what();
    }
    return {};
  };
  const auto broken = directory.write("broken.mof", "class A {};\nclass B {}");
  const auto including = directory.write("including.mof", "#pragma include(\"broken.mof\")");
  EXPECT_EQ(read(broken), broken.string() + ":2: expected \";\", not end of text");
  EXPECT_EQ(read(including), broken.string() + ":2: expected \";\", not end of text");
  EXPECT_EQ(read(directory.path() / "none.mof"),
            (directory.path() / "none.mof").string() + ": cannot be read: No such file or directory");
  std::filesystem::create_directory(directory.path() / "empty");
  EXPECT_THAT(read(directory.path() / "empty"), HasSubstr("contains no *.mof file"));
}

}  // namespace
