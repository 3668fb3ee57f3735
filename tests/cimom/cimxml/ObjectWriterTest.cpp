// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/ObjectWriter.h"
#include "tests/cimom/cimxml/EndpointTest.h"

namespace {

using namespace Cimom;

class ObjectWriterTest : public Testing::EndpointTest {
 protected:
  Instance machine(const char* name) const {
    return {*manager_.classes().find("root/test", "TEST_Machine"),
            ObjectPath{"", "root/test", "TEST_Machine", keyed(name)}};
  }

  static NamedValues keyed(const char* name) {
    NamedValues keys;
    keys.set("Name", Value::string(name));
    return keys;
  }

  // What the same writer writes for each of the instances.
  static std::vector<std::string> written(const std::vector<Instance>& instances, CimXml::PropertyFilter filter = {}) {
    const std::string host = "server";
    const std::string nameSpace = "root/test";
    CimXml::XmlWriter xml(CimXml::XmlWriter::Prolog::None);
    CimXml::ObjectWriter writer(xml, host, nameSpace, std::move(filter));
    std::vector<std::string> all;
    for (const Instance& instance : instances) {
      writer.instance(instance);
      all.push_back(xml.take());
    }
    return all;
  }

  static std::string alone(const Instance& instance) { return written({instance}).front(); }
};

TEST_F(ObjectWriterTest, WritesEveryInstanceOfAClassAlike) {
  Instance filled = machine("filled");
  filled.set("Inner", Value::instance(machine("inner")));
  filled.set("Inners", Value::array(Array{CMPI_instance, {Value::instance(machine("first")), Value()}}));
  Instance asTexts = machine("texts");
  asTexts.set("Inner", Value::string("<&>"));
  const std::vector<Instance> instances = {machine("empty"), filled, asTexts, machine("empty"), filled};
  const auto together = written(instances);
  for (std::size_t index = 0; index < instances.size(); ++index) {
    EXPECT_EQ(together[index], alone(instances[index]));
  }
  EXPECT_EQ(alone(asTexts),
            "<INSTANCE CLASSNAME=\"TEST_Machine\">"
            "<PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>texts</VALUE></PROPERTY>"
            "<PROPERTY NAME=\"Inner\" TYPE=\"string\"><VALUE>&lt;&amp;&gt;</VALUE></PROPERTY>"
            "<PROPERTY.ARRAY NAME=\"Inners\" TYPE=\"string\" EmbeddedObject=\"instance\"></PROPERTY.ARRAY>"
            "<PROPERTY NAME=\"Anything\" TYPE=\"string\" EmbeddedObject=\"object\"></PROPERTY></INSTANCE>");
}

TEST_F(ObjectWriterTest, TellsTheClassesOfInstancesThatFollowEachOtherApart) {
  const Instance thing(*manager_.classes().find("root/test", "TEST_Thing"), ObjectPath{"", "", "TEST_Thing", {}});
  const std::vector<Instance> instances = {thing, thing, machine("a"), machine("b"), thing, thing};
  const auto together = written(instances);
  for (std::size_t index = 0; index < instances.size(); ++index) {
    EXPECT_EQ(together[index], alone(instances[index]));
  }
}

TEST_F(ObjectWriterTest, LeavesOutOfEveryInstanceWhatIsNotWanted) {
  const std::string expected =
      "<INSTANCE CLASSNAME=\"TEST_Machine\">"
      "<PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>a</VALUE></PROPERTY></INSTANCE>";
  const std::vector<std::string> three(3, expected);
  EXPECT_EQ(
      written({machine("a"), machine("a"), machine("a")}, CimXml::PropertyFilter(std::vector<std::string>{"name"})),
      three);
}

}  // namespace
