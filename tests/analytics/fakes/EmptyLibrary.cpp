// A library without the function that is looked for.
extern "C" __attribute__((visibility("default"))) const int LBXNothing;
const int LBXNothing = 0;
