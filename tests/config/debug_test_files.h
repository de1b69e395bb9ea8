#ifndef OVO_TESTS_CONFIG_DEBUG_TEST_FILES_H
#define OVO_TESTS_CONFIG_DEBUG_TEST_FILES_H

#include <filesystem>
#include <fstream>
#include <initializer_list>
#include <sstream>
#include <string>

// Files below the unit tests' device root, addressed by their device path.
inline std::string RootPath(const std::string& device_path) {
    return std::string(OVO_TEST_DEVICE_ROOT) + device_path;
}

inline void WriteDeviceFile(const std::string& device_path, const std::string& content) {
    std::filesystem::path path = RootPath(device_path);
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << content;
}

// The file's content, or "<missing>".
inline std::string ReadDeviceFile(const std::string& device_path) {
    std::ifstream in(RootPath(device_path), std::ios::binary);
    if (!in) return "<missing>";
    std::ostringstream content;
    content << in.rdbuf();
    return content.str();
}

// Removes device folders with everything in them, so that a test starts from nothing.
inline void RemoveDeviceTrees(std::initializer_list<const char*> device_paths) {
    for (const char* device_path : device_paths) {
        std::error_code ignored;
        std::filesystem::remove_all(RootPath(device_path), ignored);
    }
}

#endif
