#include "device_profile.h"

#include <cstdio>
#include <filesystem>
#include <string>
#include <system_error>

#include "config/stereo_profile.h"

namespace {

std::filesystem::path InstalledProfile(const char* root) {
    return std::string(root) + ovo::PROFILE_PATH;
}

}  // namespace

bool InstallProfile(const char* root, const char* profile) {
    const std::filesystem::path installed = InstalledProfile(root);
    std::error_code error;
    std::filesystem::create_directories(installed.parent_path(), error);
    if (!error) {
        std::filesystem::copy_file(profile, installed,
                                   std::filesystem::copy_options::overwrite_existing, error);
    }
    if (error) {
        std::fprintf(stderr, "stereo_draw_bench: cannot install %s as %s: %s\n", profile,
                     installed.c_str(), error.message().c_str());
        return false;
    }
    return true;
}

bool RemoveProfile(const char* root) {
    const std::filesystem::path installed = InstalledProfile(root);
    std::error_code error;
    std::filesystem::remove(installed, error);
    if (error) {
        std::fprintf(stderr, "stereo_draw_bench: cannot remove %s: %s\n", installed.c_str(),
                     error.message().c_str());
        return false;
    }
    return true;
}
