#ifndef OVO_ENTRY_EXPORT_H
#define OVO_ENTRY_EXPORT_H

// Marks one of the entry points that the platform's EGL loader looks up by name.
#define OVO_EXPORT __attribute__((visibility("default")))

#endif
