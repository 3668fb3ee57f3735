// SPDX-License-Identifier: Apache-2.0
// The embedded object manager's broker and objects with every slot of every function table interposed: each call can be
// counted and can fail.
#pragma once

#include <cmpift.h>

#include "cimom/broker/Handle.h"

namespace Testing {

// Gives the object the interposed table. Null, or already interposed, it stays as it is.
void interpose(CMPIString* object);
void interpose(CMPIObjectPath* object);
void interpose(CMPIInstance* object);
void interpose(CMPIArray* object);
void interpose(CMPIEnumeration* object);
void interpose(CMPIArgs* object);
void interpose(CMPIDateTime* object);
void interpose(CMPIContext* object);
void interpose(CMPIResult* object);
void interpose(CMPIError* object);

// The broker with interposed tables; up-calls for instances are answered by `enumerateInstances`, the property filters
// of instances are announced to `filtered`.
using EnumerateInstances = decltype(CMPIBrokerFT::enumerateInstances);
using Filtered = void (*)(const CMPIInstance*, const char** properties, const char** keys);
const CMPIBroker* interposedBroker(const CMPIBroker* real, EnumerateInstances enumerateInstances, Filtered filtered);

}  // namespace Testing
