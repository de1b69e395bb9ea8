#ifndef OVO_TESTS_SUPPORT_VENDOR_ROOT_H
#define OVO_TESTS_SUPPORT_VENDOR_ROOT_H

#include <string>

// The vendor folder of the test device root. Every test runs in a process of its own and
// sets the folder up before its first eglGetDisplay.
namespace vendor_root {

std::string VendorDirectory();
// Empties the vendor folder (and creates it).
void Reset();
// Links `library` as "<base_name>_<tag>.so" into the vendor folder.
void Install(const char* base_name, const char* tag, const std::string& library);
// The recording EGL, ES 1.x and ES 2.0 libraries under the first GPU tag.
void InstallRecorder();

// The built recording libraries.
std::string RecordingEgl();
std::string RecordingGles1();
std::string RecordingGles1Sparse();
std::string RecordingGles2();

}  // namespace vendor_root

#endif
