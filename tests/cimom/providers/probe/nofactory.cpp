// A library that loads but has no provider in it.
extern "C" __attribute__((visibility("default"))) int nothingToSeeHere() { return 0; }
