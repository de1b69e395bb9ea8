#ifndef OVO_BENCH_DEVICE_PROFILE_H
#define OVO_BENCH_DEVICE_PROFILE_H

// The stereo profile of a device root, set up as the companion application would before
// the game starts. The library deletes the file when it reads it, so each run installs it
// anew.

// Copies the binary profile `profile` into `root`; false after printing why.
bool InstallProfile(const char* root, const char* profile);

// Leaves `root` without a profile; false after printing why.
bool RemoveProfile(const char* root);

#endif
