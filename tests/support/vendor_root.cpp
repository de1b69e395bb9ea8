#include "vendor_root.h"

#include <unistd.h>

#include <cstdlib>
#include <filesystem>

namespace vendor_root {

std::string VendorDirectory() { return OVO_TEST_DEVICE_ROOT "/system/vendor/lib/egl"; }

void Reset() {
    std::filesystem::remove_all(VendorDirectory());
    std::filesystem::create_directories(VendorDirectory());
}

void Install(const char* base_name, const char* tag, const std::string& library) {
    std::string link = VendorDirectory() + "/" + base_name + "_" + tag + ".so";
    std::filesystem::remove(link);
    std::filesystem::create_symlink(library, link);
}

void InstallRecorder() {
    Reset();
    Install("libEGL", "mali", RecordingEgl());
    Install("libGLESv1_CM", "mali", RecordingGles1());
    Install("libGLESv2", "mali", RecordingGles2());
}

std::string RecordingEgl() { return OVO_RECORDING_EGL; }
std::string RecordingGles1() { return OVO_RECORDING_GLES1; }
std::string RecordingGles1Sparse() { return OVO_RECORDING_GLES1_SPARSE; }
std::string RecordingGles2() { return OVO_RECORDING_GLES2; }

}  // namespace vendor_root
