// SPDX-License-Identifier: Apache-2.0
// The underlying provider in an object manager that hands out what it should not: null objects with a good status, good
// objects with a bad one, nulls for paths, names and results. Every request ends with a status, and nothing is followed
// that is not there.
#include <cmpimacs.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/support/agent/AgentEnvironment.h"
#include "tests/support/broker/BrokerFixture.h"

extern "C" CMPIInstanceMI* UnderlyingIPConfigProvider_Create_InstanceMI(const CMPIBroker*, const CMPIContext*,
                                                                        CMPIStatus*);

namespace {

using namespace Testing;
using testing::HasSubstr;

constexpr const char* systemClass = "YRNQV_SPComputerSystem";

// How a maker misbehaves, and what the request then says of it.
enum class Misbehaviour { NullWithoutAnError, WithoutAHandle, GoodBesideAnError };

constexpr Misbehaviour misbehaviours[] = {Misbehaviour::NullWithoutAnError, Misbehaviour::WithoutAHandle,
                                          Misbehaviour::GoodBesideAnError};

Misbehaviour misbehaviour;

template <typename Object>
Object* misbehave(Object* good, CMPIStatus* status) {
  static Object withoutHandle;
  withoutHandle = {nullptr, good->ft};
  if (status) {
    *status = {misbehaviour == Misbehaviour::GoodBesideAnError ? CMPI_RC_ERR_INVALID_CLASS : CMPI_RC_OK, nullptr};
  }
  if (misbehaviour == Misbehaviour::NullWithoutAnError) {
    return nullptr;
  }
  return misbehaviour == Misbehaviour::WithoutAHandle ? &withoutHandle : good;
}

// Where the provider puts its results.
struct Results {
  int delivered = 0;
  int ends = 0;
  CMPIrc answer = CMPI_RC_OK;
};

Results& of(const CMPIResult* result) { return *static_cast<Results*>(result->hdl); }

class HostileObjectManagerTest : public BrokerFixture {
 protected:
  HostileObjectManagerTest() : encapsulation_(*broker->eft), broker_(*broker) {
    AgentEnvironment::instance().reset();
    manager.loadSchemaText(R"(
      class YRNQV_SPComputerSystem {
        [key] string CreationClassName; [key] string Name;
        string Description; string NameFormat; uint16 Dedicated[];
      };
    )",
                           "root/yrnse");
    broker_.eft = &encapsulation_;
    real = broker;
    provider_ = UnderlyingIPConfigProvider_Create_InstanceMI(&broker_, nullptr, nullptr);
    resultTable_.returnInstance = [](const CMPIResult* result, const CMPIInstance*) {
      ++of(result).delivered;
      return CMPIStatus{of(result).answer, nullptr};
    };
    resultTable_.returnObjectPath = [](const CMPIResult* result, const CMPIObjectPath*) {
      ++of(result).delivered;
      return CMPIStatus{of(result).answer, nullptr};
    };
    resultTable_.returnDone = [](const CMPIResult* result) {
      ++of(result).ends;
      return CMPIStatus{CMPI_RC_OK, nullptr};
    };
  }
  ~HostileObjectManagerTest() override { UnderlyingIPConfigProvider_Create_InstanceMI(broker, nullptr, nullptr); }

  CMPIStatus enumerateNames(const CMPIObjectPath* of, const CMPIResult* to) {
    return provider_->ft->enumerateInstanceNames(provider_, nullptr, to, of);
  }
  CMPIStatus enumerate(const CMPIObjectPath* of, const CMPIResult* to, const char** wanted = nullptr) {
    return provider_->ft->enumerateInstances(provider_, nullptr, to, of, wanted);
  }
  CMPIStatus get(const CMPIObjectPath* of, const CMPIResult* to) {
    return provider_->ft->getInstance(provider_, nullptr, to, of, nullptr);
  }

  CMPIObjectPath* classPath() const { return path(systemClass, "root/yrnse"); }

  static std::string message(const CMPIStatus& status) { return status.msg ? characters(status.msg) : "(none)"; }

  // A request fails with the text, delivers nothing more, and the log holds why.
  void expectFailure(const CMPIStatus& status, const std::string& text) {
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(message(status), HasSubstr(text));
    EXPECT_THAT(readFile(AgentEnvironment::instance().log()), HasSubstr(text));
    EXPECT_EQ(results_.ends, 0);
  }

  static inline const CMPIBroker* real = nullptr;

  CMPIBrokerEncFT encapsulation_;
  CMPIBroker broker_;
  CMPIInstanceMI* provider_ = nullptr;
  Results results_;
  CMPIResultFT resultTable_{};
  const CMPIResult result_{&results_, &resultTable_};
};

TEST_F(HostileObjectManagerTest, IsAnsweredWhereItBehaves) {
  EXPECT_EQ(enumerate(classPath(), &result_).rc, CMPI_RC_OK);
  EXPECT_EQ(results_.delivered, 1);
  EXPECT_EQ(results_.ends, 1);
}

TEST_F(HostileObjectManagerTest, IsToldThatItPassesNoPathOrNoResult) {
  CMPIObjectPath withoutHandle{nullptr, classPath()->ft};
  const CMPIStatus statuses[] = {enumerateNames(nullptr, &result_),
                                 enumerateNames(&withoutHandle, &result_),
                                 enumerateNames(classPath(), nullptr),
                                 enumerate(nullptr, &result_),
                                 enumerate(&withoutHandle, &result_),
                                 enumerate(classPath(), nullptr),
                                 get(nullptr, &result_),
                                 get(&withoutHandle, &result_),
                                 get(classPath(), nullptr)};
  for (const CMPIStatus& status : statuses) {
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_THAT(message(status), HasSubstr("passes no object path"));
  }
  EXPECT_EQ(results_.delivered, 0);
}

TEST_F(HostileObjectManagerTest, IsToldThatAPathWithoutAClassNamesNoneThatIsServed) {
  Altered altered(classPath());
  altered.table.getClassName = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
  EXPECT_EQ(enumerate(altered, &result_).rc, CMPI_RC_ERR_INVALID_CLASS);

  altered.table.getClassName = [](const CMPIObjectPath*, CMPIStatus*) {
    CMPIString* name = CMNewString(real, systemClass, nullptr);
    static CMPIStringFT table;
    table = *name->ft;
    table.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
    name->ft = &table;
    return name;
  };
  EXPECT_EQ(enumerateNames(altered, &result_).rc, CMPI_RC_ERR_INVALID_CLASS);
}

TEST_F(HostileObjectManagerTest, MayLeaveTheNamespaceOut) {
  static std::string asked;
  encapsulation_.newObjectPath = [](const CMPIBroker*, const char* nameSpace, const char* name, CMPIStatus* status) {
    asked = nameSpace;
    return CMNewObjectPath(real, "root/yrnse", name, status);
  };
  Altered altered(classPath());
  altered.table.getNameSpace = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
  asked = "not asked";
  EXPECT_EQ(enumerateNames(altered, &result_).rc, CMPI_RC_OK);
  EXPECT_EQ(asked, "");
}

TEST_F(HostileObjectManagerTest, ThatMakesNoObjectPathIsToldSo) {
  encapsulation_.newObjectPath = [](const CMPIBroker*, const char* nameSpace, const char* name, CMPIStatus* status) {
    return misbehave(CMNewObjectPath(real, nameSpace, name, nullptr), status);
  };
  CMPIObjectPath* requested = classPath();
  for (const Misbehaviour each : misbehaviours) {
    misbehaviour = each;
    const std::string text = "does not make an object path of YRNQV_SPComputerSystem";
    expectFailure(enumerateNames(requested, &result_), text);
    expectFailure(enumerate(requested, &result_), text);
    expectFailure(get(requested, &result_), text);
  }
  EXPECT_EQ(results_.delivered, 0);
}

TEST_F(HostileObjectManagerTest, ThatMakesNoInstanceIsToldSo) {
  encapsulation_.newInstance = [](const CMPIBroker*, const CMPIObjectPath* path, CMPIStatus* status) {
    return misbehave(CMNewInstance(real, path, nullptr), status);
  };
  for (const Misbehaviour each : misbehaviours) {
    misbehaviour = each;
    expectFailure(enumerate(classPath(), &result_), "does not make an instance of YRNQV_SPComputerSystem");
  }
  EXPECT_EQ(results_.delivered, 0);
}

TEST_F(HostileObjectManagerTest, ThatMakesNoArrayIsToldSo) {
  encapsulation_.newArray = [](const CMPIBroker*, CMPICount count, CMPIType type, CMPIStatus* status) {
    return misbehave(CMNewArray(real, count, type, nullptr), status);
  };
  for (const Misbehaviour each : misbehaviours) {
    misbehaviour = each;
    expectFailure(enumerate(classPath(), &result_), "does not make an array for Dedicated");
  }
  EXPECT_EQ(results_.delivered, 0);
}

TEST_F(HostileObjectManagerTest, ThatDoesNotFillAnArrayIsToldSo) {
  encapsulation_.newArray = [](const CMPIBroker*, CMPICount count, CMPIType type, CMPIStatus* status) {
    CMPIArray* array = CMNewArray(real, count, type, status);
    static CMPIArrayFT table;
    table = *array->ft;
    table.setElementAt = [](CMPIArray*, CMPICount, const CMPIValue*, CMPIType) {
      return CMPIStatus{CMPI_RC_ERR_TYPE_MISMATCH, nullptr};
    };
    array->ft = &table;
    return array;
  };
  expectFailure(enumerate(classPath(), &result_), "does not fill an array for Dedicated: status 13");
}

TEST_F(HostileObjectManagerTest, ThatDoesNotTakeAKeyIsToldSoAndWhy) {
  encapsulation_.newObjectPath = [](const CMPIBroker*, const char* nameSpace, const char* name, CMPIStatus* status) {
    CMPIObjectPath* path = CMNewObjectPath(real, nameSpace, name, status);
    static CMPIObjectPathFT table;
    table = *path->ft;
    table.addKey = [](CMPIObjectPath*, const char*, const CMPIValue*, CMPIType) {
      return CMPIStatus{CMPI_RC_ERROR_SYSTEM, CMNewString(real, "no memory", nullptr)};
    };
    path->ft = &table;
    return path;
  };
  expectFailure(enumerateNames(classPath(), &result_),
                "does not take the key CreationClassName: status 100, no memory");
}

TEST_F(HostileObjectManagerTest, IsAskedToFilterOnlyWhereThereIsAListAndThenWithTheKeys) {
  static std::string filters;
  encapsulation_.newInstance = [](const CMPIBroker*, const CMPIObjectPath* path, CMPIStatus* status) {
    CMPIInstance* instance = CMNewInstance(real, path, status);
    static CMPIInstanceFT table;
    table = *instance->ft;
    table.setPropertyFilter = [](CMPIInstance*, const char** wanted, const char** keys) {
      filters += wanted ? "list;" : "no list;";
      for (; *keys; ++keys) {
        filters += std::string(" ") + *keys;
      }
      return CMPIStatus{CMPI_RC_OK, nullptr};
    };
    instance->ft = &table;
    return instance;
  };
  filters.clear();
  EXPECT_EQ(enumerate(classPath(), &result_).rc, CMPI_RC_OK);
  EXPECT_EQ(filters, "");

  const char* none[] = {nullptr};
  EXPECT_EQ(enumerate(classPath(), &result_, none).rc, CMPI_RC_OK);
  EXPECT_EQ(filters, "list; CreationClassName Name");
}

TEST_F(HostileObjectManagerTest, ThatMakesNoStringGetsAStatusWithoutAMessage) {
  encapsulation_.newObjectPath = [](const CMPIBroker*, const char*, const char*, CMPIStatus*) -> CMPIObjectPath* {
    return nullptr;
  };
  encapsulation_.newString = [](const CMPIBroker*, const char* text, CMPIStatus* status) {
    return misbehave(CMNewString(real, text, nullptr), status);
  };
  CMPIObjectPath* requested = classPath();
  for (const Misbehaviour each : misbehaviours) {
    misbehaviour = each;
    const CMPIStatus status = enumerateNames(requested, &result_);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
  }
}

TEST_F(HostileObjectManagerTest, ThatTakesNoResultsIsOfferedNoMoreOfThem) {
  results_.answer = CMPI_RC_ERR_FAILED;
  expectFailure(enumerate(classPath(), &result_), "does not take an instance of YRNQV_SPComputerSystem");
  expectFailure(enumerateNames(classPath(), &result_), "does not take an object path of YRNQV_SPComputerSystem");
  EXPECT_EQ(results_.delivered, 2);
}

}  // namespace
