// A plug-in library of the fake map, loaded by the tests as the host loads libpigmo.so. Built twice:
// once as this host expects it, once answering another version.
#include "FakeMap.h"

#define ENTRY extern "C" __attribute__((visibility("default")))

ENTRY const MCHAR* LibDescription() {
    return "Fake maps";
}

ENTRY int LibNumberClasses() {
    return 2;
}

// The second class is missing, as a host may meet it.
ENTRY ClassDesc* LibClassDesc(int i) {
    return i == 0 ? &Fake::Class() : nullptr;
}

ENTRY ULONG LibVersion() {
    return FAKE_PLUGIN_VERSION;
}
