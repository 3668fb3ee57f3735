// SPDX-License-Identifier: Apache-2.0
// Enumerations that a client reads in pieces (DSP0200, 5.3.2.24), against the probe provider with its three things.

#include "tests/cimom/cimxml/EndpointTest.h"
#include "tests/support/system/Pattern.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

std::string text(const std::string& name, const std::string& value) { return parameter(name, Testing::value(value)); }

// The value of an output parameter; empty if it is null or not there.
std::string output(const std::string& reply, const std::string& name) {
  const Pattern::Match match =
      Pattern("<PARAMVALUE NAME=\"" + name + "\" PARAMTYPE=\"[a-z]+\"><VALUE>([^<]*)</VALUE></PARAMVALUE>")
          .first(reply);
  return match.empty() ? std::string() : match[1];
}

bool isEnd(const std::string& reply) { return output(reply, "EndOfSequence") == "TRUE"; }

class PullOperationsTest : public EndpointTest {
 protected:
  std::string open(const std::string& parameters = "") const {
    return returned("OpenEnumerateInstances", className("TEST_Thing") + parameters);
  }

  std::string pull(const std::string& method, const std::string& context, const std::string& most) const {
    return returned(method, text("EnumerationContext", context) + text("MaxObjectCount", most));
  }
};

TEST_F(PullOperationsTest, OpensWithoutAnItemUnlessAskedForOne) {
  const std::string reply = open();
  EXPECT_THAT(reply, StartsWith("<IRETURNVALUE></IRETURNVALUE><PARAMVALUE NAME=\"EnumerationContext\""));
  EXPECT_FALSE(isEnd(reply));
  EXPECT_NE(output(reply, "EnumerationContext"), "");
}

TEST_F(PullOperationsTest, ReturnsAllAtOnceAndNothingStaysOpen) {
  const std::string reply = open(text("MaxObjectCount", "3"));
  EXPECT_EQ(count(reply, "<VALUE.INSTANCEWITHPATH><INSTANCEPATH><NAMESPACEPATH><HOST>"), 3);
  EXPECT_TRUE(isEnd(reply));
  EXPECT_EQ(output(reply, "EnumerationContext"), "");
}

TEST_F(PullOperationsTest, PullsWhatIsLeftInTheOrderOfTheEnumeration) {
  std::string all = returned("EnumerateInstances", className("TEST_Thing"));
  std::string reply = open(text("MaxObjectCount", "1"));
  const std::string context = output(reply, "EnumerationContext");
  std::string pieces = reply;
  int pulls = 0;
  for (; !isEnd(reply) && pulls < 10; ++pulls) {
    reply = pull("PullInstancesWithPath", context, "1");
    EXPECT_EQ(count(reply, "<VALUE.INSTANCEWITHPATH>"), 1);
    pieces += reply;
  }
  EXPECT_EQ(pulls, 2);
  const auto numbers = [](const std::string& xml) {
    std::vector<std::string> found;
    for (const Pattern::Match& number : Pattern("NAME=\"Number\"><KEYVALUE[^>]*>([0-9]+)<").all(xml)) {
      found.push_back(number[1]);
    }
    return found;
  };
  EXPECT_EQ(numbers(pieces), numbers(all));
  EXPECT_THAT(failed("PullInstancesWithPath", text("EnumerationContext", context) + text("MaxObjectCount", "1")),
              StartsWith("21: "));
}

TEST_F(PullOperationsTest, APullOfNothingKeepsTheRest) {
  const std::string context = output(open(), "EnumerationContext");
  EXPECT_FALSE(isEnd(pull("PullInstancesWithPath", context, "0")));
  const std::string reply = pull("PullInstancesWithPath", context, "4294967295");
  EXPECT_EQ(count(reply, "<VALUE.INSTANCEWITHPATH>"), 3);
  EXPECT_TRUE(isEnd(reply));
}

TEST_F(PullOperationsTest, TrimsPropertiesAsTheEnumerationDoes) {
  const std::string list = parameter("PropertyList", "<VALUE.ARRAY><VALUE>Flag</VALUE></VALUE.ARRAY>");
  const std::string reply = open(list + text("MaxObjectCount", "9"));
  EXPECT_EQ(count(reply, "<PROPERTY NAME=\"Flag\""), 3);
  EXPECT_EQ(count(reply, "<PROPERTY "), 3);
}

TEST_F(PullOperationsTest, OpensPaths) {
  const std::string context =
      output(returned("OpenEnumerateInstancePaths", className("TEST_Thing")), "EnumerationContext");
  EXPECT_THAT(failed("PullInstancesWithPath", text("EnumerationContext", context) + text("MaxObjectCount", "1")),
              StartsWith("21: "));
  const std::string reply = pull("PullInstancePaths", context, "5");
  EXPECT_EQ(count(reply, "<INSTANCEPATH><NAMESPACEPATH>"), 3);
  EXPECT_EQ(count(reply, "<INSTANCE "), 0);
  EXPECT_TRUE(isEnd(reply));
}

// The objects of the operation that returns them at once, in the elements of the pulled form.
TEST_F(PullOperationsTest, OpensTraversalsOfAssociations) {
  struct Row {
    const char* whole;
    const char* opened;
    const char* element;
    const char* pulledElement;
  };
  for (const Row& row :
       {Row{"Associators", "OpenAssociatorInstances", "VALUE.OBJECTWITHPATH>", "VALUE.INSTANCEWITHPATH>"},
        Row{"AssociatorNames", "OpenAssociatorInstancePaths", "</?OBJECTPATH>", ""},
        Row{"References", "OpenReferenceInstances", "VALUE.OBJECTWITHPATH>", "VALUE.INSTANCEWITHPATH>"},
        Row{"ReferenceNames", "OpenReferenceInstancePaths", "</?OBJECTPATH>", ""}}) {
    SCOPED_TRACE(row.opened);
    const std::string whole = returned(row.whole, parameter("ObjectName", thingName()));
    const std::string opened =
        returned(row.opened, parameter("InstanceName", thingName()) + text("MaxObjectCount", "100"));
    EXPECT_THAT(whole, HasSubstr("<INSTANCEPATH>"));
    EXPECT_EQ(opened.substr(0, opened.find("<PARAMVALUE")), Pattern(row.element).replaced(whole, row.pulledElement));
    EXPECT_TRUE(isEnd(opened));
  }
  EXPECT_THAT(failed("OpenAssociatorInstances", parameter("ObjectName", thingName())), StartsWith("4: "));
}

TEST_F(PullOperationsTest, CountsAndClosesWhatIsOpen) {
  const std::string context = output(open(), "EnumerationContext");
  EXPECT_EQ(returned("EnumerationCount", text("EnumerationContext", context)),
            "<IRETURNVALUE><VALUE>3</VALUE></IRETURNVALUE>");
  EXPECT_EQ(returned("CloseEnumeration", text("EnumerationContext", context)), "");
  EXPECT_THAT(failed("CloseEnumeration", text("EnumerationContext", context)), StartsWith("21: "));
  EXPECT_THAT(failed("EnumerationCount", text("EnumerationContext", context)), StartsWith("21: "));
}

TEST_F(PullOperationsTest, RefusesWhatItDoesNotOffer) {
  const std::string thing = className("TEST_Thing");
  EXPECT_THAT(failed("OpenEnumerateInstances", thing + text("OperationTimeout", "0")),
              "22: parameter OperationTimeout must be a number from 1 to 3600");
  EXPECT_THAT(failed("OpenEnumerateInstances", thing + text("OperationTimeout", "3601")), StartsWith("22: "));
  EXPECT_THAT(failed("OpenEnumerateInstances", thing + text("FilterQuery", "x")), StartsWith("25: "));
  EXPECT_THAT(failed("OpenEnumerateInstances", thing + text("FilterQueryLanguage", "DMTF:FQL")), StartsWith("25: "));
  EXPECT_THAT(failed("OpenEnumerateInstances", thing + text("ContinueOnError", "TRUE")), StartsWith("26: "));
  EXPECT_THAT(open(text("ContinueOnError", "FALSE") + text("OperationTimeout", "3600")), HasSubstr("FALSE"));
}

TEST_F(PullOperationsTest, NamesTheParameterThatIsMissingOrWrong) {
  EXPECT_EQ(failed("OpenEnumerateInstances", ""), "4: parameter ClassName is missing");
  EXPECT_EQ(failed("PullInstancesWithPath", text("MaxObjectCount", "1")), "4: parameter EnumerationContext is missing");
  EXPECT_EQ(failed("CloseEnumeration", ""), "4: parameter EnumerationContext is missing");
  const std::string context = output(open(), "EnumerationContext");
  EXPECT_EQ(failed("PullInstancesWithPath", text("EnumerationContext", context)),
            "4: parameter MaxObjectCount is missing");
  EXPECT_EQ(failed("OpenEnumerateInstances", className("TEST_Thing") + text("MaxObjectCount", "-1")),
            "4: parameter MaxObjectCount must be a number from 0 to 4294967295");
}

TEST_F(PullOperationsTest, FailsWhereTheEnumerationFails) {
  EXPECT_THAT(failed("OpenEnumerateInstances", className("TEST_Failing")),
              failed("EnumerateInstances", className("TEST_Failing")));
}

}  // namespace
