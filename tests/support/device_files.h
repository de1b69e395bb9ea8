#ifndef OVO_TESTS_SUPPORT_DEVICE_FILES_H
#define OVO_TESTS_SUPPORT_DEVICE_FILES_H

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

// Files below the test device root.
namespace device_files {

inline std::string Path(const std::string& device_path) { return OVO_TEST_DEVICE_ROOT + device_path; }

inline void Write(const std::string& device_path, const std::string& text) {
    std::filesystem::create_directories(std::filesystem::path(Path(device_path)).parent_path());
    std::ofstream(Path(device_path), std::ios::binary) << text;
}

inline std::string Read(const std::string& device_path, const std::string& when_missing = "") {
    std::ifstream file(Path(device_path), std::ios::binary);
    if (!file) return when_missing;
    std::stringstream text;
    text << file.rdbuf();
    return text.str();
}

inline void Remove(const std::string& device_path) { std::filesystem::remove(Path(device_path)); }

// A profile file as the companion application writes it: header, then 24 items of words.
inline std::string ProfileFile(const std::vector<std::pair<uint32_t, std::vector<uint32_t>>>& items) {
    std::string bytes;
    auto word = [&bytes](uint32_t value, int size) {
        for (int shift = 8 * (size - 1); shift >= 0; shift -= 8) bytes += static_cast<char>(value >> shift);
    };
    word(0, 4), word(1, 4), word(0, 4), word(0, 4);  // the second word marks the file valid
    for (size_t item = 0; item < 24; ++item) {
        uint32_t id = item < items.size() ? items[item].first : 0;
        const std::vector<uint32_t> payload = item < items.size() ? items[item].second : std::vector<uint32_t>{};
        word(id, 4), word(0x1003, 2), word(static_cast<uint32_t>(payload.size()), 2);
        for (uint32_t value : payload) word(value, 4);
    }
    return bytes;
}

}  // namespace device_files

#endif
