#ifndef OVO_TESTS_SUPPORT_DEVICE_FILES_H
#define OVO_TESTS_SUPPORT_DEVICE_FILES_H

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

// Files below the test device root.
namespace device_files {

inline std::string Path(const std::string& device_path) { return OVO_TEST_DEVICE_ROOT + device_path; }

inline void Write(const std::string& device_path, const std::string& text) {
    std::filesystem::create_directories(std::filesystem::path(Path(device_path)).parent_path());
    std::ofstream(Path(device_path), std::ios::binary) << text;
}

inline std::string Read(const std::string& device_path) {
    std::ifstream file(Path(device_path), std::ios::binary);
    std::stringstream text;
    text << file.rdbuf();
    return text.str();
}

inline void Remove(const std::string& device_path) { std::filesystem::remove(Path(device_path)); }

}  // namespace device_files

#endif
