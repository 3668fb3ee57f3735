#ifndef CIMOM_ROUTING_ASSOCIATIONOPERATIONS_H_
#define CIMOM_ROUTING_ASSOCIATIONOPERATIONS_H_

#include "cimom/routing/ProviderCall.h"

namespace Cimom {

/// What narrows an association operation down (DSP0200); each may be null. Only the association class does so here:
/// the others go to the provider as they came.
struct AssociationFilter {
  const char* associationClass;
  const char* resultClass;
  const char* role;
  const char* resultRole;
};

/// The association operations of DSP0200 on the operation's path. Each asks the provider of every association class
/// once and gives it that class's name, whatever the caller named: a class that has a provider itself is asked alone;
/// its registered subclasses, and without any name every registered association, are asked where one of their
/// references can refer to the path's class. Whether the source object exists is not checked. All throw StatusError,
/// CMPI_RC_ERR_INVALID_PARAMETER for an association class that the schema does not know.
std::vector<Value> associators(const Operation& operation, const AssociationFilter& filter, const char** properties);
std::vector<Value> associatorNames(const Operation& operation, const AssociationFilter& filter);

/// References and their names: the association class is what CMPI calls the result class of these operations.
std::vector<Value> references(const Operation& operation, const AssociationFilter& filter, const char** properties);
std::vector<Value> referenceNames(const Operation& operation, const AssociationFilter& filter);

}  // namespace Cimom

#endif  // CIMOM_ROUTING_ASSOCIATIONOPERATIONS_H_
