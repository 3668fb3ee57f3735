// load LIBRARY FUNCTION...: loads a provider library as an object manager does and looks up its factories.
#include <dlfcn.h>

#include <cstdio>

int main(int argc, char** argv) {
  void* const library = argc > 1 ? dlopen(argv[1], RTLD_NOW | RTLD_LOCAL) : nullptr;
  if (!library) {
    std::fprintf(stderr, "load: %s\n", argc > 1 ? dlerror() : "usage: load LIBRARY FUNCTION...");
    return 1;
  }
  for (int i = 2; i < argc; ++i) {
    if (!dlsym(library, argv[i])) {
      std::fprintf(stderr, "load: %s\n", dlerror());
      return 1;
    }
  }
  std::printf("%d factories found\n", argc - 2);
  return 0;
}
