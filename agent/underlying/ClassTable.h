// The underlying classes: what each is called, what names an instance, what makes its instances.
#pragma once

#include <array>

#include "agent/underlying/InstanceBuilders.h"

namespace QV {

struct UnderlyingClass {
  const char* name;
  std::array<const char*, 5> keys;  // ends with a null, as an object manager takes it
  Instances (*build)(const System& system);
  bool ofHostToo;  // whether it has instances of the host, too, which agent.ini must ask for
};

// The class of that name, letters without regard to case; null if there is none.
const UnderlyingClass* findUnderlyingClass(const char* name);

// All instances of a class: those of the management processor, then those of the host where the class has them and
// agent.ini asks for them. Throws what reading the processor throws.
Instances readInstances(const UnderlyingClass& underlyingClass);

}  // namespace QV
