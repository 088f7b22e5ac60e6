// A library that has the host's name but another interface version.
extern "C" __attribute__((visibility("default"))) int ForeignHostCall() {
    return 1;
}
