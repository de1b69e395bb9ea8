#ifndef OVO_TESTS_CONFIG_PROFILE_TEST_BYTES_H
#define OVO_TESTS_CONFIG_PROFILE_TEST_BYTES_H

// Builds binary stereo profile files byte by byte (big-endian), independently of the
// library's writer, and puts them where the library looks for them.
#include <cstdint>
#include <cstring>
#include <filesystem>
#include <initializer_list>
#include <string>
#include <vector>

#include "config/stereo_profile.h"
#include "support/device_files.h"

namespace profile_bytes {

inline std::string Be32(uint32_t value) {
    return {static_cast<char>(value >> 24), static_cast<char>(value >> 16), static_cast<char>(value >> 8),
            static_cast<char>(value)};
}

inline std::string Be16(uint16_t value) { return {static_cast<char>(value >> 8), static_cast<char>(value)}; }

// The 16-byte header: validity word at offset 4, the rest 0.
inline std::string Header(uint32_t validity = 1) { return Be32(0) + Be32(validity) + Be32(0) + Be32(0); }

// One item exactly as given: head and payload bytes.
inline std::string Item(uint32_t id, int16_t type, int16_t count, const std::string& payload = "") {
    return Be32(id) + Be16(static_cast<uint16_t>(type)) + Be16(static_cast<uint16_t>(count)) + payload;
}

inline std::string Words(uint32_t id, std::initializer_list<uint32_t> values, int16_t type = 0x1003) {
    std::string payload;
    for (uint32_t value : values) payload += Be32(value);
    return Item(id, type, static_cast<int16_t>(values.size()), payload);
}

inline std::string Float(uint32_t id, float value) {
    uint32_t bits;
    std::memcpy(&bits, &value, sizeof(bits));
    return Words(id, {bits});
}

inline std::string Flag(uint32_t id, bool value) { return Words(id, {value ? 1u : 0u}); }

// The items followed by padding items (id 0, type 0, count 0) up to 24.
inline std::string Items(const std::vector<std::string>& items) {
    std::string bytes;
    for (const std::string& item : items) bytes += item;
    for (size_t index = items.size(); index < 24; ++index) bytes += Item(0, 0, 0);
    return bytes;
}

// A complete file: header and 24 items.
inline std::string File(const std::vector<std::string>& items, uint32_t validity = 1) {
    return Header(validity) + Items(items);
}

// The profile file below the unit tests' device root (folders created as needed).
inline void Install(const std::string& bytes) { device_files::Write(ovo::PROFILE_PATH, bytes); }
inline void Uninstall() { device_files::Remove(ovo::PROFILE_PATH); }

}  // namespace profile_bytes

#endif
