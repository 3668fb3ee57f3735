// SPDX-License-Identifier: Apache-2.0
// The comparison of object paths held to a second statement of what makes two of them name one instance: thousands of
// pairs, the second of which says what the first says in another way, or differs from it in one thing.
#include <QV/ProviderHelper.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <random>
#include <string>
#include <variant>
#include <vector>

#include "tests/agent/helper/SampleFixture.h"

namespace {

using namespace QV;
using namespace Testing;

struct StatedPath;

struct StatedNull {};

struct StatedNumber {
  long long value;
  bool isSigned;
  std::size_t width;  // 0 to 3: 8 to 64 bits
};

using StatedValue =
    std::variant<StatedNull, bool, StatedNumber, std::string, std::vector<StatedPath>>;  // the last: one reference

struct StatedPath {
  std::string className;
  std::string nameSpace;
  std::vector<std::pair<std::string, StatedValue>> keys;
};

std::string lowerCase(std::string name) {
  std::transform(name.begin(), name.end(), name.begin(), [](unsigned char letter) { return std::tolower(letter); });
  return name;
}

bool denoteOne(const StatedPath& a, const StatedPath& b);

// Numbers by what they count, whatever their types; all else by type and exactly.
bool isOneValue(const StatedValue& a, const StatedValue& b) {
  if (a.index() != b.index()) {
    return false;
  }
  if (const auto* number = std::get_if<StatedNumber>(&a)) {
    return number->value == std::get<StatedNumber>(b).value;
  }
  if (const auto* text = std::get_if<std::string>(&a)) {
    return *text == std::get<std::string>(b);
  }
  if (const auto* truth = std::get_if<bool>(&a)) {
    return *truth == std::get<bool>(b);
  }
  const auto* reference = std::get_if<std::vector<StatedPath>>(&a);
  return !reference || denoteOne(reference->front(), std::get<std::vector<StatedPath>>(b).front());
}

// By class and keys: names without regard to case, the keys in any order, hosts and namespaces not at all.
bool denoteOne(const StatedPath& a, const StatedPath& b) {
  return lowerCase(a.className) == lowerCase(b.className) && a.keys.size() == b.keys.size() &&
         std::all_of(a.keys.begin(), a.keys.end(), [&](const auto& key) {
           return std::any_of(b.keys.begin(), b.keys.end(), [&](const auto& other) {
             return lowerCase(key.first) == lowerCase(other.first) && isOneValue(key.second, other.second);
           });
         });
}

class ObjectPathModelTest : public SampleFixture {
 protected:
  std::size_t below(std::size_t limit) { return std::uniform_int_distribution<std::size_t>(0, limit - 1)(random_); }
  bool perhaps(std::size_t oneIn) { return below(oneIn) == 0; }

  StatedValue anyValue(int depth) {
    switch (below(depth > 0 ? 6 : 5)) {
      case 0:
        return perhaps(4) ? StatedValue(StatedNull()) : StatedValue(perhaps(2));
      case 1:
      case 2:
        return StatedNumber{static_cast<long long>(below(3)) - 1, true, below(4)};
      case 5:
        return std::vector<StatedPath>{anyPath(depth - 1)};
      default:
        return std::string(perhaps(2) ? "eth" : "ETH") + std::to_string(below(2));
    }
  }

  StatedPath anyPath(int depth) {
    StatedPath path{perhaps(3) ? "Other" : "Unknown", "", {}};
    for (const char* name : {"CreationClassName", "Name", "SystemName"}) {
      if (!perhaps(4)) {
        path.keys.emplace_back(name, anyValue(depth));
      }
    }
    return path;
  }

  std::string respelled(std::string name) {
    for (char& letter : name) {
      letter = static_cast<char>(perhaps(2) ? std::toupper(letter) : std::tolower(letter));
    }
    return name;
  }

  // The same said in another way.
  StatedPath reworded(StatedPath path) {
    path.className = respelled(path.className);
    for (auto& [name, value] : path.keys) {
      name = respelled(name);
      if (auto* number = std::get_if<StatedNumber>(&value)) {
        number->isSigned = number->value < 0 || perhaps(2);
        number->width = below(4);
      } else if (auto* reference = std::get_if<std::vector<StatedPath>>(&value)) {
        reference->front() = reworded(reference->front());
      }
    }
    if (perhaps(2)) {
      std::shuffle(path.keys.begin(), path.keys.end(), random_);
    }
    return path;
  }

  // A path that may differ in one thing.
  StatedPath changed(StatedPath path) {
    switch (below(4)) {
      case 0:
        path.className = perhaps(2) ? "Other" : "Unknown";
        break;
      case 1:
        if (!path.keys.empty()) {
          path.keys.erase(path.keys.begin() + static_cast<std::ptrdiff_t>(below(path.keys.size())));
        }
        break;
      case 2:
        if (!path.keys.empty()) {
          path.keys[below(path.keys.size())].first = "DeviceID";
        }
        break;
      default:
        if (!path.keys.empty()) {
          path.keys[below(path.keys.size())].second = anyValue(1);
        }
    }
    return path;
  }

  CMPIObjectPath* made(const StatedPath& stated) {
    CMPIObjectPath* path = this->path(stated.className.c_str());
    for (const auto& [name, value] : stated.keys) {
      addKey(path, name.c_str(), value);
    }
    return path;
  }

  void addKey(CMPIObjectPath* path, const char* name, const StatedValue& stated) {
    CMPIValue value{};
    CMPIType type = CMPI_string;
    if (const auto* truth = std::get_if<bool>(&stated)) {
      value.boolean = *truth ? 1 : 0;
      type = CMPI_boolean;
    } else if (const auto* number = std::get_if<StatedNumber>(&stated)) {
      // The low bytes of the number come first on every machine that this is built for.
      value.sint64 = number->value;
      const CMPIType types[][2] = {
          {CMPI_uint8, CMPI_sint8}, {CMPI_uint16, CMPI_sint16}, {CMPI_uint32, CMPI_sint32}, {CMPI_uint64, CMPI_sint64}};
      type = types[number->width][number->isSigned ? 1 : 0];
    } else if (const auto* text = std::get_if<std::string>(&stated)) {
      value.string = CMNewString(broker, text->c_str(), nullptr);
    } else if (const auto* reference = std::get_if<std::vector<StatedPath>>(&stated)) {
      value.ref = made(reference->front());
      type = CMPI_ref;
    }
    EXPECT_EQ(CMAddKey(path, name, &value, type).rc, CMPI_RC_OK) << name;
  }

  std::mt19937 random_{20240229};
};

TEST_F(ObjectPathModelTest, AgreesOnWhichPathsDenoteOneInstance) {
  int equal = 0;
  constexpr int pairs = 4000;
  for (int pair = 0; pair < pairs; ++pair) {
    const Cimom::RequestScope scope(broker);
    const StatedPath stated = anyPath(2);
    const StatedPath other = perhaps(8) ? anyPath(2) : reworded(perhaps(2) ? stated : changed(stated));
    const bool expected = denoteOne(stated, other);
    CMPIObjectPath* a = made(stated);
    CMPIObjectPath* b = made(other);
    const auto shown = [](CMPIObjectPath* path) { return characters(CMObjectPathToString(path, nullptr)); };
    EXPECT_EQ(isObjPathsEqual(a, b, false), expected) << shown(a) << "\n" << shown(b);
    EXPECT_EQ(isObjPathsEqual(b, a, false), expected) << shown(b) << "\n" << shown(a);
    equal += expected ? 1 : 0;
  }
  EXPECT_GT(equal, pairs / 3);
  EXPECT_LT(equal, pairs * 2 / 3);
}

}  // namespace
