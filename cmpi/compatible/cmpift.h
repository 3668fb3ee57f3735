// The function tables, whichever set of CMPI headers a build takes: this one stands before theirs on the include path.
// The sets in circulation agree on the binary interface and differ in how they word it; what the tree must not see of
// that is levelled here and in cmpimacs.h. tests/cmpi/stand-in lists the differences.
#pragma once

// A keyword of other compilers, by which some sets declare the start function of a thread.
#ifndef __cdecl
#define __cdecl
#endif

// Two slots have two names.
#define enumInstances enumerateInstances
#define enumInstanceNames enumerateInstanceNames
#include_next <cmpift.h>
#undef enumInstances
#undef enumInstanceNames

namespace Cmpi {

template <typename Function>
struct Parameters;

template <typename Result, typename First, typename Second, typename... Rest>
struct Parameters<Result (*)(First, Second, Rest...)> {
  using SecondType = Second;
};

// The numbers that a message is logged and traced with: int, or an enumeration.
using Severity = Parameters<decltype(CMPIBrokerEncFT::logMessage)>::SecondType;
using TraceLevel = Parameters<decltype(CMPIBrokerEncFT::trace)>::SecondType;

}  // namespace Cmpi
