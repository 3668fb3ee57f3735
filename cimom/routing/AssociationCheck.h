// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>
#include <vector>

#include "cimom/broker/Operation.h"

namespace Cimom {

// What of an association operation's filter no provider is obliged to see to: the classes that it names, the
// associations that can lead from the source, and which of their answers are asked for.
class AssociationCheck {
 public:
  // The association instances of the source, asked of the provider when they are needed.
  using References = std::function<std::vector<Value>()>;

  // Both must outlive the check.
  AssociationCheck(const Operation& operation, const AssociationFilter& filter)
      : operation_(operation), filter_(filter) {}

  // Throws StatusError CMPI_RC_ERR_INVALID_PARAMETER for a class that the namespace does not show, and for an
  // association class that is none.
  void requireClasses() const;

  // Whether the association is of the class that is asked for, and one of its references, in the asked role, can be the
  // source; and another one, in the asked role, of the result class.
  bool canLead(const ClassDefinition& association) const;

  // Whether an answer of References or ReferenceNames is of the association class, and the source has the asked role in
  // it. A path that has no key for the role is taken: a role need not be a key.
  bool isReference(const Value& answer) const;

  // Keeps what Associators or AssociatorNames are asked for. Where the classes of source and result do not tell their
  // roles apart, the association instances do.
  void filterAssociated(const ClassDefinition& association, std::vector<Value>& answers,
                        const References& references) const;

 private:
  using Reference = PropertyDeclaration;

  const ClassDefinition* classOf(const ObjectPath& path) const;
  bool canBeSource(const Reference& reference) const;
  bool isAskedPair(const Reference& source, const Reference& result) const;

  const Operation& operation_;
  const AssociationFilter& filter_;
};

}  // namespace Cimom
