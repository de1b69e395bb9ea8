#include "config/profile_file.h"

#include <cstring>

namespace ovo {

namespace {

// Where the reader takes its bytes from: a memory block or an open stdio stream.
struct ByteSource {
    const uint8_t* m_data;
    size_t m_size;
    FILE* m_file;
    size_t m_offset;
};

// Copies up to `count` bytes into `out`; returns how many arrived.
size_t Take(ByteSource& source, uint8_t* out, size_t count) {
    size_t arrived;
    if (source.m_file != nullptr) {
        arrived = std::fread(out, 1, count, source.m_file);
    } else {
        size_t left = source.m_size - source.m_offset;
        arrived = count < left ? count : left;
        if (arrived > 0) std::memcpy(out, source.m_data + source.m_offset, arrived);
    }
    source.m_offset += arrived;
    return arrived;
}

// Passes over up to `count` bytes; returns how many there were. A stream is read rather
// than sought, so that pipes work and the end of the file is noticed.
size_t Skip(ByteSource& source, size_t count) {
    if (source.m_file == nullptr) {
        size_t left = source.m_size - source.m_offset;
        size_t skipped = count < left ? count : left;
        source.m_offset += skipped;
        return skipped;
    }
    uint8_t scratch[512];
    size_t skipped = 0;
    while (skipped < count) {
        size_t chunk = count - skipped < sizeof(scratch) ? count - skipped : sizeof(scratch);
        size_t arrived = Take(source, scratch, chunk);
        skipped += arrived;
        if (arrived < chunk) break;
    }
    return skipped;
}

bool IsWordType(int16_t type) { return type == PROFILE_TYPE_WORDS || type == PROFILE_TYPE_WORDS_ALT; }

// Payload bytes that `item`'s count declares in the file (0 for a negative count or a type
// without payload).
size_t DeclaredPayloadBytes(const ProfileItem& item) {
    if (item.m_data_count <= 0) return 0;
    size_t count = static_cast<size_t>(item.m_data_count);
    if (IsWordType(item.m_data_type)) return 4 * count;
    if (item.m_data_type == PROFILE_TYPE_TEXT) return count;
    return 0;
}

// Reads one item's payload into its slot. Returns false when the file ended inside it.
// The format sets no limit on counts, the slot does: of a larger count the slot keeps what
// fits and the rest of the payload is skipped, so the items after it stay aligned with the
// file; a negative count declares no payload at all.
bool ReadPayload(ByteSource& source, ProfileItem& item, ProfileReadResult& result) {
    const bool words = IsWordType(item.m_data_type);
    if (!words && item.m_data_type != PROFILE_TYPE_TEXT) return true;  // no payload
    if (item.m_data_count < 0 || item.m_data_count > (words ? PROFILE_PAYLOAD_WORDS : PROFILE_PAYLOAD_BYTES)) {
        result.m_count_out_of_range = true;
    }
    const size_t held = static_cast<size_t>(ProfileHeldElements(item));
    if (words) {
        for (size_t index = 0; index < held; ++index) {
            uint8_t bytes[4];
            if (Take(source, bytes, 4) < 4) return false;
            item.m_data[index] = ReadBigEndian32(bytes);
        }
    } else {
        if (Take(source, reinterpret_cast<uint8_t*>(item.m_data), held) < held) return false;
    }
    // Bytes that the count declares beyond the slot are passed over, so that the next item
    // is read from where the file puts it.
    const size_t excess = DeclaredPayloadBytes(item) - (words ? 4 * held : held);
    return Skip(source, excess) == excess;
}

ProfileReadResult ReadTable(ByteSource& source, ProfileTable& table) {
    std::memset(&table, 0, sizeof(table));
    ProfileReadResult result{};
    result.m_truncated = true;

    uint8_t header[PROFILE_HEADER_SIZE];
    const size_t arrived = Take(source, header, sizeof(header));
    std::memcpy(table.m_header_lead, header, arrived < 4 ? arrived : 4);
    if (arrived >= 8) table.m_validity = ReadBigEndian32(header + 4);
    if (arrived >= 12) table.m_header_word = ReadBigEndian32(header + 8);
    if (arrived > 12) std::memcpy(table.m_header_tail, header + 12, arrived - 12);
    result.m_header_complete = arrived == sizeof(header);

    if (result.m_header_complete) {
        int index = 0;
        for (; index < PROFILE_FILE_ITEMS; ++index) {
            ProfileItem& item = table.m_items[index];
            uint8_t head[PROFILE_ITEM_HEAD_SIZE];
            const size_t got = Take(source, head, sizeof(head));
            if (got >= 4) item.m_id = ReadBigEndian32(head);
            if (got >= 6) item.m_data_type = static_cast<int16_t>(ReadBigEndian16(head + 4));
            if (got >= 8) item.m_data_count = static_cast<int16_t>(ReadBigEndian16(head + 6));
            if (got < sizeof(head) || !ReadPayload(source, item, result)) break;
            ++result.m_complete_items;
        }
        result.m_truncated = index < PROFILE_FILE_ITEMS;
    }
    result.m_bytes_consumed = source.m_offset;
    return result;
}

}  // namespace

int ProfileHeldElements(const ProfileItem& item) {
    int capacity;
    if (IsWordType(item.m_data_type)) {
        capacity = PROFILE_PAYLOAD_WORDS;
    } else if (item.m_data_type == PROFILE_TYPE_TEXT) {
        capacity = PROFILE_PAYLOAD_BYTES;
    } else {
        return 0;
    }
    if (item.m_data_count < 0) return 0;
    return item.m_data_count < capacity ? item.m_data_count : capacity;
}

ProfileReadResult ReadProfileTable(const uint8_t* data, size_t size, ProfileTable& table) {
    ByteSource source{data, data != nullptr ? size : 0, nullptr, 0};
    return ReadTable(source, table);
}

ProfileReadResult ReadProfileTable(FILE* file, ProfileTable& table) {
    // A null stream reads as an empty file.
    ByteSource source{nullptr, 0, file, 0};
    return ReadTable(source, table);
}

size_t WriteProfileTable(const ProfileTable& table, uint8_t* out, size_t capacity) {
    size_t size = PROFILE_HEADER_SIZE;
    for (int index = 0; index < PROFILE_FILE_ITEMS; ++index) {
        const ProfileItem& item = table.m_items[index];
        const bool has_payload = IsWordType(item.m_data_type) || item.m_data_type == PROFILE_TYPE_TEXT;
        if (has_payload && ProfileHeldElements(item) != item.m_data_count) {
            return 0;  // a negative count, or more than the slot holds
        }
        size += PROFILE_ITEM_HEAD_SIZE + DeclaredPayloadBytes(item);
    }
    if (out == nullptr || size > capacity) return 0;

    uint8_t* cursor = out;
    std::memcpy(cursor, table.m_header_lead, 4);
    WriteBigEndian32(table.m_validity, cursor + 4);
    WriteBigEndian32(table.m_header_word, cursor + 8);
    std::memcpy(cursor + 12, table.m_header_tail, 4);
    cursor += PROFILE_HEADER_SIZE;
    for (int index = 0; index < PROFILE_FILE_ITEMS; ++index) {
        const ProfileItem& item = table.m_items[index];
        WriteBigEndian32(item.m_id, cursor);
        WriteBigEndian16(static_cast<uint16_t>(item.m_data_type), cursor + 4);
        WriteBigEndian16(static_cast<uint16_t>(item.m_data_count), cursor + 6);
        cursor += PROFILE_ITEM_HEAD_SIZE;
        const size_t payload = DeclaredPayloadBytes(item);
        if (IsWordType(item.m_data_type)) {
            for (size_t word = 0; word < payload / 4; ++word) {
                WriteBigEndian32(item.m_data[word], cursor);
                cursor += 4;
            }
        } else {
            std::memcpy(cursor, ProfileItemBytes(item), payload);
            cursor += payload;
        }
    }
    return size;
}

}  // namespace ovo
