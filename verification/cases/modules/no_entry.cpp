// A library that is no diagnostic at all.
extern "C" __attribute__((visibility("default"))) int answer() {
    return 42;
}
