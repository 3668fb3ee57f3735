// SPDX-License-Identifier: Apache-2.0
// The fixture of the association operations: an association seen from one of its ends, with three instances at the far
// end that belong to the source.
#pragma once

#include <tuple>

#include "tests/providers/AssociationTest.h"

namespace Testing {

// The association, and whether the far end is end A.
using Direction = std::tuple<AssociationParameter, bool>;

class AssociationDirectionTest : public AssociationTest, public ::testing::WithParamInterface<Direction> {
 protected:
  AssociationDirectionTest();

  bool farIsA() const { return std::get<1>(GetParam()); }
  const std::string& farClass() const { return farIsA() ? model().endA : model().endB; }
  const std::string& sourceClass() const { return farIsA() ? model().endB : model().endA; }
  const std::string& referenceToFar() const { return farIsA() ? model().referenceToA : model().referenceToB; }
  const std::string& referenceToSource() const { return farIsA() ? model().referenceToB : model().referenceToA; }
  std::string sourceName() const;

  // The source object's path as a client sends it, with the far end filled by `farNames`.
  CMPIObjectPath* source();

  Strings farPaths(std::string (*rendering)(const std::string& compositeClass, const std::string& name)) const;
  // A reference to the source as the client sent it.
  std::string sourceReference() const;
  // "source -> far" of these references for every far name.
  Strings sourceTiedToFarNames() const;

  Strings farNames;
};

}  // namespace Testing

#define INSTANTIATE_DIRECTIONS(test)                                                                                   \
  INSTANTIATE_TEST_SUITE_P(                                                                                            \
      Twelve, test, ::testing::Combine(::testing::ValuesIn(Testing::associationParameters()), ::testing::Bool()),      \
      [](const auto& parameter) {                                                                                      \
        return std::get<0>(parameter.param).model->className + (std::get<1>(parameter.param) ? "_toEndA" : "_toEndB"); \
      })
