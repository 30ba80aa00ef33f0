// The toolkit's platform and the font configuration keep what they made to the end of the process;
// they are not ours to free. The address sanitizer asks this function for its options.
extern "C" __attribute__((visibility("default"))) const char* __asan_default_options(); // NOLINT
extern "C" const char* __asan_default_options() {                                       // NOLINT
    return "detect_leaks=0";
}
