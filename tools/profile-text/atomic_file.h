#ifndef OVO_TOOLS_PROFILE_TEXT_ATOMIC_FILE_H
#define OVO_TOOLS_PROFILE_TEXT_ATOMIC_FILE_H

#include <cstddef>
#include <cstdint>
#include <string>

namespace ovo_profile {

// Writes `size` bytes to a temporary file in `path`'s folder and renames it to `path`, so
// that `path` is either left as it was or replaced as a whole, and a reader never sees a
// part. On failure says why in `problem` (naming `path`) and leaves no temporary file.
bool WriteFileAtomically(const std::string& path, const uint8_t* bytes, size_t size, std::string& problem);

inline bool WriteFileAtomically(const std::string& path, const std::string& text, std::string& problem) {
    return WriteFileAtomically(path, reinterpret_cast<const uint8_t*>(text.data()), text.size(), problem);
}

}  // namespace ovo_profile

#endif
