#ifndef OVO_BENCH_LIBRARY_SYMBOL_H
#define OVO_BENCH_LIBRARY_SYMBOL_H

#include <dlfcn.h>

#include <cstdio>

// `name` in `library` (null when the library did not open) as a `Function`; null after
// printing what is missing.
template <typename Function>
Function LibrarySymbol(void* library, const char* name) {
    void* found = library != nullptr ? dlsym(library, name) : nullptr;
    if (found == nullptr) std::fprintf(stderr, "stereo_draw_bench: %s not found\n", name);
    return reinterpret_cast<Function>(found);
}

// Opens `path` with its own symbols kept to itself, as the platform's loader opens a GL
// driver; null after printing why.
inline void* OpenLibrary(const char* path) {
    void* library = dlopen(path, RTLD_NOW | RTLD_LOCAL);
    if (library == nullptr) std::fprintf(stderr, "stereo_draw_bench: %s\n", dlerror());
    return library;
}

#endif
