// A library that is no plugin.
extern "C" __attribute__((visibility("default"))) int somethingElse() {
    return 42;
}
