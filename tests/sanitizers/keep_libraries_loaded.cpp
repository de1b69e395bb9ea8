// Preloaded into every program of the AddressSanitizer suite. LeakSanitizer finds live
// memory through the data of the libraries that are loaded at exit; Mesa unloads its driver
// at eglTerminate, and the memory that the driver's data still pointed to would then look
// leaked. With dlclose doing nothing, every library stays loaded to the end.
extern "C" __attribute__((visibility("default"))) int dlclose(void*) { return 0; }
