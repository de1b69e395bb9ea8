// Any bytes as the stereo profile file: the reader must stay inside the data and inside
// its slots, read the same table from memory and from a stream, and a complete file whose
// counts fit the slots must write back to exactly the bytes that were read.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "config/profile_file.h"
#include "config/stereo_profile_fields.h"

namespace {

// Stops the run where the fault is, so the fuzzer keeps the input.
void Check(bool condition) {
    if (!condition) std::abort();
}

bool IsClear(const ovo::ProfileItem& item) {
    static const ovo::ProfileItem CLEAR{};
    return std::memcmp(&item, &CLEAR, sizeof(item)) == 0;
}

void CheckResult(const ovo::ProfileReadResult& result, const ovo::ProfileTable& table, size_t size) {
    Check(result.m_bytes_consumed <= size);
    Check(result.m_complete_items >= 0 && result.m_complete_items <= ovo::PROFILE_FILE_ITEMS);
    Check(result.m_truncated == (result.m_complete_items < ovo::PROFILE_FILE_ITEMS));
    Check(result.m_header_complete == (size >= ovo::PROFILE_HEADER_SIZE));
    // A file never fills more than 24 slots, and nothing after a truncation.
    const int first_unread = result.m_complete_items + (result.m_truncated ? 1 : 0);
    for (int index = first_unread; index < ovo::PROFILE_SLOT_COUNT; ++index) Check(IsClear(table.m_items[index]));
    if (!result.m_truncated) Check(result.m_bytes_consumed >= ovo::PROFILE_HEADER_SIZE + 24 * ovo::PROFILE_ITEM_HEAD_SIZE);
}

void CheckFields(const ovo::ProfileTable& table) {
    static const char* const NAMES[] = {"", "com.Paladog.Lite", "com.android.wallpaper", "fishnoodle.snowfall"};
    for (const char* name : NAMES) {
        ovo::StereoProfileFields fields;
        if (table.m_validity != 0) ovo::ApplyProfileItems(fields, table);
        fields.m_enabled = fields.m_valid;
        ovo::SelectOutputSize(fields);
        ovo::ApplyLiveWallpaperPreset(fields, ovo::LiveWallpaperKindOf(name));
        const uint32_t mode = fields.m_mode != 0 ? fields.m_mode : ovo::ModeForProcess(fields, name);
        Check(mode >= ovo::STEREO_MODE_OFF && mode <= ovo::STEREO_MODE_SHADER_LISTED);
        Check(fields.m_valid || mode == ovo::STEREO_MODE_OFF);
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    ovo::ProfileTable table;
    const ovo::ProfileReadResult result = ovo::ReadProfileTable(data, size, table);
    CheckResult(result, table, size);

    // The stream reader (the library's path) sees the same file.
    if (size > 0) {
        FILE* stream = fmemopen(const_cast<uint8_t*>(data), size, "rb");
        Check(stream != nullptr);
        ovo::ProfileTable from_stream;
        const ovo::ProfileReadResult stream_result = ovo::ReadProfileTable(stream, from_stream);
        std::fclose(stream);
        Check(std::memcmp(&table, &from_stream, sizeof(table)) == 0);
        Check(stream_result.m_bytes_consumed == result.m_bytes_consumed);
        Check(stream_result.m_complete_items == result.m_complete_items);
    }

    CheckFields(table);

    // Round trip: what was read in full writes back byte for byte.
    static uint8_t written[ovo::PROFILE_FILE_CAPACITY];
    const size_t length = ovo::WriteProfileTable(table, written, sizeof(written));
    if (!result.m_truncated && !result.m_count_out_of_range) {
        Check(length == result.m_bytes_consumed);
        Check(std::memcmp(written, data, length) == 0);
    }
    if (length != 0) {
        ovo::ProfileTable again;
        const ovo::ProfileReadResult reread = ovo::ReadProfileTable(written, length, again);
        Check(!reread.m_truncated && reread.m_bytes_consumed == length);
    }
    return 0;
}
