// The convenience macros, whichever set of CMPI headers a build takes (see cmpift.h beside this file): some are
// functions that take a value as const CMPIValue* only, some are left out unless a version is asked for.
#pragma once

#include <cmpift.h>

#define enumInstances enumerateInstances
#define enumInstanceNames enumerateInstanceNames
#include_next <cmpimacs.h>
#undef enumInstances
#undef enumInstanceNames

#undef CBEnumInstances
#define CBEnumInstances(b, ctx, path, properties, rc) \
  ((b)->bft->enumerateInstances((b), (ctx), (path), (properties), (rc)))
#undef CBEnumInstanceNames
#define CBEnumInstanceNames(b, ctx, path, rc) ((b)->bft->enumerateInstanceNames((b), (ctx), (path), (rc)))

#undef CMObjectPathToString
#define CMObjectPathToString(p, rc) ((p)->ft->toString((p), (rc)))

// A value travels as a pointer to it, or for CMPI_chars as the characters themselves.
#define CMPI_VALUE_AT(pointer) static_cast<const CMPIValue*>(static_cast<const void*>(pointer))

#undef CMSetProperty
#define CMSetProperty(i, name, value, type) ((i)->ft->setProperty((i), (name), CMPI_VALUE_AT(value), (type)))
#undef CMSetPropertyWithOrigin
#define CMSetPropertyWithOrigin(i, name, value, type, origin) \
  ((i)->ft->setPropertyWithOrigin((i), (name), CMPI_VALUE_AT(value), (type), (origin)))
#undef CMAddKey
#define CMAddKey(p, name, value, type) ((p)->ft->addKey((p), (name), CMPI_VALUE_AT(value), (type)))
#undef CMSetArrayElementAt
#define CMSetArrayElementAt(a, index, value, type) ((a)->ft->setElementAt((a), (index), CMPI_VALUE_AT(value), (type)))
#undef CMAddArg
#define CMAddArg(a, name, value, type) ((a)->ft->addArg((a), (name), CMPI_VALUE_AT(value), (type)))
#undef CMAddContextEntry
#define CMAddContextEntry(c, name, value, type) ((c)->ft->addEntry((c), (name), CMPI_VALUE_AT(value), (type)))
#undef CMReturnData
#define CMReturnData(r, value, type) ((r)->ft->returnData((r), CMPI_VALUE_AT(value), (type)))
