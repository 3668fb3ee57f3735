#include <QV/ProviderHelper.h>

namespace QV {
namespace {

// Not tolower: CIM names are ASCII, and a locale must not change what is equal.
char lower(char character) {
  return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
}

}  // namespace

bool textEqual(const char* a, const char* b) {
  if (!a || !b) {
    return false;
  }
  while (*a && lower(*a) == lower(*b)) {
    ++a;
    ++b;
  }
  return lower(*a) == lower(*b);
}

}  // namespace QV
