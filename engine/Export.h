#pragma once

// Marks the classes and functions that libpigmo.so exports; everything else stays hidden.
#if defined(PIGMO_STATIC)
#define PIGMO_API
#else
#define PIGMO_API __attribute__((visibility("default")))
#endif
