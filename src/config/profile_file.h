#ifndef OVO_CONFIG_PROFILE_FILE_H
#define OVO_CONFIG_PROFILE_FILE_H

// The binary stereo profile file: a 16-byte header and 24 items, every number big-endian.
// Reading and writing only; what an item does to the profile lives in
// config/stereo_profile_fields.h. Depends on nothing but the standard library, so the
// library, the ovo-profile tool and the fuzz targets share these sources.

#include <cstddef>
#include <cstdint>
#include <cstdio>

namespace ovo {

constexpr size_t PROFILE_HEADER_SIZE = 16;
constexpr size_t PROFILE_ITEM_HEAD_SIZE = 8;
// Items in a file; bytes after the last one are never read.
constexpr int PROFILE_FILE_ITEMS = 24;
// Slots in the reader's table (more than a file fills).
constexpr int PROFILE_SLOT_COUNT = 32;
// Payload area of one slot: 32 words or 128 bytes.
constexpr int PROFILE_PAYLOAD_WORDS = 32;
constexpr int PROFILE_PAYLOAD_BYTES = 4 * PROFILE_PAYLOAD_WORDS;
// The largest file that a slot table can be written to: every item with a full payload.
constexpr size_t PROFILE_FILE_CAPACITY =
    PROFILE_HEADER_SIZE + PROFILE_FILE_ITEMS * (PROFILE_ITEM_HEAD_SIZE + PROFILE_PAYLOAD_BYTES);

// Payload types (`m_data_type`).
enum ProfileDataType : int16_t {
    PROFILE_TYPE_WORDS = 0x1003,      // m_data_count 32-bit big-endian words
    PROFILE_TYPE_WORDS_ALT = 0x1004,  // the same as PROFILE_TYPE_WORDS
    PROFILE_TYPE_TEXT = 0x1005,       // m_data_count raw bytes
};

// Item ids (`m_id`). Ids without an entry here, and 0 (padding), change nothing.
enum ProfileItemId : uint32_t {
    PROFILE_ITEM_EYE_DISTANCE = 0x2001,   // float
    PROFILE_ITEM_EYE_SHIFT = 0x2002,      // float
    PROFILE_ITEM_EYE_ANGLE = 0x2003,      // float
    PROFILE_ITEM_RAMP_STEPS = 0x2004,     // float
    PROFILE_ITEM_EYE_AXIS = 0x2005,       // word 0
    PROFILE_ITEM_RAMP_PARAM = 0x2006,     // word 0
    PROFILE_ITEM_SPLIT = 0x2101,          // word 0
    PROFILE_ITEM_EYE_ORDER = 0x2102,      // word 0
    PROFILE_ITEM_RAMP = 0x2111,           // word 0
    PROFILE_ITEM_TARGET_SIZE = 0x2201,    // words 0 and 1
    PROFILE_ITEM_SCREEN_SIZE = 0x2202,    // words 0 and 1
    PROFILE_ITEM_SHADER_CONVERT = 0x2301, // flag
    PROFILE_ITEM_USE_SCREEN_SIZE = 0x2302,// flag
    PROFILE_ITEM_UNUSED_2303 = 0x2303,    // flag, not used
    PROFILE_ITEM_AUTO_EYE = 0x2304,       // flag
    PROFILE_ITEM_UNUSED_2305 = 0x2305,    // flag, not used
    PROFILE_ITEM_UNUSED_2306 = 0x2306,    // flag, not used
    PROFILE_ITEM_UNUSED_2307 = 0x2307,    // flag, not used
    PROFILE_ITEM_EYE_TARGET = 0x2308,     // flag
    PROFILE_ITEM_VALID = 0x2403,          // flag
    PROFILE_ITEM_TEXT = 0x2501,           // NUL-terminated text, not used
};

// One item as the reader holds it. `m_data_count` is the count exactly as the file gives
// it (it may exceed the payload area or be negative); `m_data` holds at most 32 words or
// 128 bytes of it. Words are stored in host order at m_data[0], [1], ...; text bytes are
// stored unchanged from the first byte of m_data on.
struct ProfileItem {
    uint32_t m_id;
    int16_t m_data_type;
    int16_t m_data_count;
    uint32_t m_data[PROFILE_PAYLOAD_WORDS];
};

// The reader's table: the header's two words (host order), its other bytes unchanged, and
// the slots (a file fills the first 24).
struct ProfileTable {
    uint8_t m_header_lead[4];  // file offsets 0..3
    uint32_t m_validity;       // file offset 4: items apply only when it is non-zero
    uint32_t m_header_word;    // file offset 8: not interpreted
    uint8_t m_header_tail[4];  // file offsets 12..15
    ProfileItem m_items[PROFILE_SLOT_COUNT];
};

// What a read found, beyond the table itself.
struct ProfileReadResult {
    // Items whose head and whole declared payload were in the file (0..24).
    int m_complete_items;
    // The 16-byte header arrived in full.
    bool m_header_complete;
    // The file ended before the end of the 24th item.
    bool m_truncated;
    // Some item declared more payload than a slot holds, or a negative count.
    bool m_count_out_of_range;
    // Bytes consumed from the start of the file (read or skipped).
    size_t m_bytes_consumed;
};

// Elements of `item`'s payload that the slot holds: the count clamped to 0..32 words for
// the word types, 0..128 bytes for text, 0 for any other type. (What arrived from a
// truncated file may be less.)
int ProfileHeldElements(const ProfileItem& item);

// The payload bytes of a text item (valid for ProfileHeldElements(item) bytes).
inline const uint8_t* ProfileItemBytes(const ProfileItem& item) {
    return reinterpret_cast<const uint8_t*>(item.m_data);
}

// Clears the table (every byte 0) and reads the header and 24 items from `size` bytes at
// `data` (or from `file`, which is read from its current position and left open). Never
// reads beyond the given data and never writes beyond a slot:
// - a count larger than the slot (more than 32 words or 128 bytes) stores what fits and
//   skips the rest of that item's payload in the file, so the items after it are read
//   from where the file puts them;
// - a negative count declares no payload: nothing is read for it;
// - an unknown type reads no payload; the next item starts right after the 8-byte head;
// - a file that ends early leaves the rest of the table cleared; a number (id, type,
//   count, a payload word, a header word) is stored only when all its bytes arrived,
//   text bytes as far as they arrived.
ProfileReadResult ReadProfileTable(const uint8_t* data, size_t size, ProfileTable& table);
ProfileReadResult ReadProfileTable(FILE* file, ProfileTable& table);

// Writes the header and the first 24 slots of `table` as a file into `out` (header bytes
// as held, the validity word and the other header word big-endian). Each item is written
// with its count and as much payload as that count declares. Returns the number of bytes,
// or 0 (nothing usable) when `capacity` is too small or an item's count is negative or
// larger than its slot holds. PROFILE_FILE_CAPACITY bytes always suffice.
size_t WriteProfileTable(const ProfileTable& table, uint8_t* out, size_t capacity);

// Big-endian helpers.
inline uint32_t ReadBigEndian32(const uint8_t* bytes) {
    return (static_cast<uint32_t>(bytes[0]) << 24) | (static_cast<uint32_t>(bytes[1]) << 16) |
           (static_cast<uint32_t>(bytes[2]) << 8) | static_cast<uint32_t>(bytes[3]);
}
inline uint16_t ReadBigEndian16(const uint8_t* bytes) {
    return static_cast<uint16_t>((bytes[0] << 8) | bytes[1]);
}
inline void WriteBigEndian32(uint32_t value, uint8_t* bytes) {
    bytes[0] = static_cast<uint8_t>(value >> 24);
    bytes[1] = static_cast<uint8_t>(value >> 16);
    bytes[2] = static_cast<uint8_t>(value >> 8);
    bytes[3] = static_cast<uint8_t>(value);
}
inline void WriteBigEndian16(uint16_t value, uint8_t* bytes) {
    bytes[0] = static_cast<uint8_t>(value >> 8);
    bytes[1] = static_cast<uint8_t>(value);
}

}  // namespace ovo

#endif
