// The profile file reader: what lands in which slot, where each item starts, and that no
// count, type or truncation makes it read past the data or write past a slot.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <functional>
#include <string>
#include <vector>

#include "config/profile_file.h"
#include "config/stereo_profile_fields.h"
#include "profile_test_bytes.h"

namespace {

using namespace profile_bytes;
using ovo::ProfileReadResult;
using ovo::ProfileTable;

ProfileReadResult ReadBytes(const std::string& bytes, ProfileTable& table) {
    return ovo::ReadProfileTable(reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size(), table);
}

// The same bytes through the stream reader, from a real file.
ProfileReadResult ReadStream(const std::string& bytes, ProfileTable& table) {
    FILE* file = std::tmpfile();
    std::fwrite(bytes.data(), 1, bytes.size(), file);
    std::rewind(file);
    ProfileReadResult result = ovo::ReadProfileTable(file, table);
    std::fclose(file);
    return result;
}

std::string SlotText(const ovo::ProfileItem& item, size_t length) {
    return std::string(reinterpret_cast<const char*>(ovo::ProfileItemBytes(item)), length);
}

float FloatBits(uint32_t bits) {
    float value;
    std::memcpy(&value, &bits, sizeof(value));
    return value;
}

struct ReaderCase {
    const char* m_name;
    std::string m_bytes;
    std::function<void(const ProfileTable&, const ProfileReadResult&)> m_check;
};

std::vector<ReaderCase> ReaderCases() {
    const std::string enabled = Flag(0x2301, true) + Flag(0x2403, true);
    std::string forty_words;
    for (uint32_t value = 0; value < 40; ++value) forty_words += Be32(value + 100);
    std::string two_hundred_bytes;
    for (int value = 0; value < 200; ++value) two_hundred_bytes += static_cast<char>(value);
    const std::string paladog = Item(0x2501, 0x1005, 8, std::string("Paladog\0", 8));

    return {
        {"big-endian float payload BD 0F 5C 29 is -0.035",
         File({Item(0x2001, 0x1003, 1, "\xBD\x0F\x5C\x29")}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[0].m_id, 0x2001u);
             EXPECT_EQ(table.m_items[0].m_data_type, 0x1003);
             EXPECT_EQ(table.m_items[0].m_data_count, 1);
             EXPECT_EQ(table.m_items[0].m_data[0], 0xBD0F5C29u);
             EXPECT_EQ(FloatBits(table.m_items[0].m_data[0]), -0.035f);
             EXPECT_EQ(result.m_complete_items, 24);
             EXPECT_FALSE(result.m_truncated);
         }},
        {"the header's words are converted, its other bytes kept",
         "\x01\x02\x03\x04" + Be32(0x11223344) + Be32(0xA0B0C0D0) + "\x05\x06\x07\x08" + Items({}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(std::string(reinterpret_cast<const char*>(table.m_header_lead), 4), "\x01\x02\x03\x04");
             EXPECT_EQ(table.m_validity, 0x11223344u);
             EXPECT_EQ(table.m_header_word, 0xA0B0C0D0u);
             EXPECT_EQ(std::string(reinterpret_cast<const char*>(table.m_header_tail), 4), "\x05\x06\x07\x08");
             EXPECT_TRUE(result.m_header_complete);
         }},
        {"type 0x1005 with count 5 consumes exactly 5 bytes",
         File({Item(0x2501, 0x1005, 5, std::string("abcd\0", 5)), Words(0x2101, {0x3102})}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(SlotText(table.m_items[0], 5), std::string("abcd\0", 5));
             EXPECT_EQ(table.m_items[1].m_id, 0x2101u);
             EXPECT_EQ(table.m_items[1].m_data[0], 0x3102u);
             EXPECT_EQ(result.m_complete_items, 24);
             EXPECT_EQ(result.m_bytes_consumed, 16u + 24 * 8 + 5 + 4);
         }},
        {"type 0x1004 words are read like 0x1003",
         File({Words(0x2201, {640, 720}, 0x1004)}),
         [](const ProfileTable& table, const ProfileReadResult&) {
             EXPECT_EQ(table.m_items[0].m_data[0], 640u);
             EXPECT_EQ(table.m_items[0].m_data[1], 720u);
         }},
        {"40 words: the slot keeps 32, the other 8 are skipped and the next item is aligned",
         File({Item(0x2303, 0x1003, 40, forty_words), Words(0x2102, {0x3107})}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[0].m_data_count, 40) << "the count as the file gives it";
             EXPECT_EQ(ovo::ProfileHeldElements(table.m_items[0]), 32);
             for (uint32_t index = 0; index < 32; ++index) EXPECT_EQ(table.m_items[0].m_data[index], index + 100);
             EXPECT_EQ(table.m_items[1].m_id, 0x2102u);
             EXPECT_EQ(table.m_items[1].m_data[0], 0x3107u);
             EXPECT_TRUE(result.m_count_out_of_range);
             EXPECT_EQ(result.m_complete_items, 24);
         }},
        {"200 text bytes: the slot keeps 128, the other 72 are skipped and the next item is aligned",
         File({Item(0x2501, 0x1005, 200, two_hundred_bytes), Words(0x2101, {0x3102})}),
         [two_hundred_bytes](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(SlotText(table.m_items[0], 128), two_hundred_bytes.substr(0, 128));
             EXPECT_EQ(table.m_items[1].m_id, 0x2101u);
             EXPECT_EQ(table.m_items[1].m_data[0], 0x3102u);
             EXPECT_EQ(table.m_items[2].m_id, 0u);
             EXPECT_TRUE(result.m_count_out_of_range);
             EXPECT_EQ(result.m_complete_items, 24);
         }},
        {"a negative word count reads no payload; the next item follows the head",
         File({Item(0x2001, 0x1003, -1), Float(0x2003, -3.0f)}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[0].m_data_count, -1);
             EXPECT_EQ(table.m_items[0].m_data[0], 0u);
             EXPECT_EQ(table.m_items[1].m_id, 0x2003u);
             EXPECT_EQ(FloatBits(table.m_items[1].m_data[0]), -3.0f);
             EXPECT_TRUE(result.m_count_out_of_range);
             EXPECT_EQ(result.m_complete_items, 24);
         }},
        {"a negative text count reads no payload; the next item follows the head",
         File({Item(0x2501, 0x1005, -32768), Words(0x2102, {0x3107})}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[1].m_id, 0x2102u);
             EXPECT_EQ(table.m_items[1].m_data[0], 0x3107u);
             EXPECT_EQ(result.m_complete_items, 24);
         }},
        {"an unknown type reads no payload; the next item follows the 8-byte head",
         File({Item(0x2001, 0x0042, 3), Float(0x2002, 0.01f)}),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[0].m_id, 0x2001u);
             EXPECT_EQ(table.m_items[0].m_data_type, 0x0042);
             EXPECT_EQ(table.m_items[0].m_data[0], 0u);
             EXPECT_EQ(table.m_items[1].m_id, 0x2002u);
             EXPECT_EQ(FloatBits(table.m_items[1].m_data[0]), 0.01f);
             EXPECT_FALSE(result.m_count_out_of_range);
             EXPECT_EQ(result.m_bytes_consumed, 16u + 24 * 8 + 4);
         }},
        {"a count of 32767 words in a short file stops at the end of the data",
         Header() + Item(0x2001, 0x1003, 32767, Be32(0xBD0F5C29) + Be32(7)),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[0].m_data[0], 0xBD0F5C29u);
             EXPECT_EQ(table.m_items[0].m_data[1], 7u);
             EXPECT_EQ(table.m_items[0].m_data[2], 0u);
             EXPECT_TRUE(result.m_truncated);
             EXPECT_EQ(result.m_complete_items, 0);
             EXPECT_EQ(result.m_bytes_consumed, 16u + 8 + 8);
         }},
        {"a file ending inside a word keeps the complete words only",
         (Header() + Words(0x2201, {640, 720})).substr(0, 16 + 8 + 6),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[0].m_id, 0x2201u);
             EXPECT_EQ(table.m_items[0].m_data[0], 640u);
             EXPECT_EQ(table.m_items[0].m_data[1], 0u);
             EXPECT_TRUE(result.m_truncated);
             EXPECT_EQ(result.m_bytes_consumed, 30u);
         }},
        {"a file ending inside an item head keeps the numbers that arrived whole",
         Header() + enabled + Be32(0x2101) + "\x10",
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_items[1].m_id, 0x2403u);
             EXPECT_EQ(table.m_items[2].m_id, 0x2101u);
             EXPECT_EQ(table.m_items[2].m_data_type, 0);
             EXPECT_EQ(result.m_complete_items, 2);
             EXPECT_TRUE(result.m_truncated);
         }},
        {"a file shorter than its header: the validity word counts if it arrived",
         Header(7).substr(0, 10),
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_validity, 7u);
             EXPECT_EQ(table.m_header_word, 0u);
             EXPECT_FALSE(result.m_header_complete);
             EXPECT_EQ(table.m_items[0].m_id, 0u);
         }},
        {"an empty file leaves the table clear",
         "",
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(table.m_validity, 0u);
             EXPECT_EQ(result.m_bytes_consumed, 0u);
             EXPECT_TRUE(result.m_truncated);
         }},
        {"bytes after the 24th item are not read, and no 25th slot is filled",
         File({paladog}) + Flag(0x2403, true) + "more",
         [](const ProfileTable& table, const ProfileReadResult& result) {
             EXPECT_EQ(SlotText(table.m_items[0], 8), std::string("Paladog\0", 8));
             EXPECT_EQ(result.m_bytes_consumed, 16u + 24 * 8 + 8);
             for (int index = 24; index < ovo::PROFILE_SLOT_COUNT; ++index) EXPECT_EQ(table.m_items[index].m_id, 0u);
         }},
    };
}

TEST(ProfileFileTest, ReaderCases) {
    for (const ReaderCase& each : ReaderCases()) {
        SCOPED_TRACE(each.m_name);
        ProfileTable table;
        ProfileReadResult result = ReadBytes(each.m_bytes, table);
        EXPECT_LE(result.m_bytes_consumed, each.m_bytes.size());
        each.m_check(table, result);

        ProfileTable from_stream;
        ProfileReadResult stream_result = ReadStream(each.m_bytes, from_stream);
        EXPECT_EQ(std::memcmp(&table, &from_stream, sizeof(table)), 0) << "the stream reader differs";
        EXPECT_EQ(stream_result.m_bytes_consumed, result.m_bytes_consumed);
        EXPECT_EQ(stream_result.m_truncated, result.m_truncated);
    }
}

TEST(ProfileFileTest, TheReaderClearsWhatAnEarlierReadLeft) {
    ProfileTable table;
    ReadBytes(File({Words(0x2201, {1, 2, 3, 4, 5})}), table);
    ReadBytes("", table);
    const ProfileTable clear{};
    EXPECT_EQ(std::memcmp(&table, &clear, sizeof(table)), 0);
}

TEST(ProfileFileTest, AWellFormedFileWritesBackByteForByte) {
    const std::string bytes = "\x01\x02\x03\x04" + Be32(5) + Be32(6) + "\x07\x08\x09\x0A" +
                              Items({Float(0x2001, -0.035f), Item(0x2501, 0x1005, 5, std::string("abcd\0", 5)),
                                     Item(0x7777, 0x0042, -9), Words(0x2202, {1280, 720}, 0x1004)});
    ProfileTable table;
    ProfileReadResult result = ReadBytes(bytes, table);
    ASSERT_FALSE(result.m_truncated);
    uint8_t written[ovo::PROFILE_FILE_CAPACITY];
    size_t size = ovo::WriteProfileTable(table, written, sizeof(written));
    EXPECT_EQ(std::string(reinterpret_cast<const char*>(written), size), bytes);
    EXPECT_EQ(ovo::WriteProfileTable(table, written, size - 1), 0u) << "too small a buffer";
}

TEST(ProfileFileTest, TheWriterRefusesCountsThatDoNotFitASlot) {
    for (int16_t count : {int16_t{-1}, int16_t{33}}) {
        ProfileTable table{};
        table.m_items[3].m_id = 0x2303;
        table.m_items[3].m_data_type = 0x1003;
        table.m_items[3].m_data_count = count;
        uint8_t written[ovo::PROFILE_FILE_CAPACITY];
        EXPECT_EQ(ovo::WriteProfileTable(table, written, sizeof(written)), 0u) << count;
    }
    ProfileTable table{};
    table.m_items[0].m_data_type = 0x1005;
    table.m_items[0].m_data_count = 129;
    uint8_t written[ovo::PROFILE_FILE_CAPACITY];
    EXPECT_EQ(ovo::WriteProfileTable(table, written, sizeof(written)), 0u);
}

// What the items set, by id alone.
TEST(ProfileFileTest, ItemsSetTheirFields) {
    ProfileTable table;
    ReadBytes(File({Float(0x2001, -0.035f), Float(0x2002, 0.01f), Float(0x2003, -0.05f), Float(0x2004, 2.0f),
                    Words(0x2005, {0x3002}), Words(0x2006, {0x3003}), Words(0x2101, {0x3101}),
                    Words(0x2102, {0x3107}), Words(0x2111, {0x3202}), Words(0x2201, {800, 480}),
                    Words(0x2202, {1024, 600}), Words(0x2301, {5}), Flag(0x2302, true), Flag(0x2303, true),
                    Flag(0x2304, true), Flag(0x2305, true), Flag(0x2306, true), Flag(0x2307, true),
                    Flag(0x2308, true), Flag(0x2403, true), Item(0x2501, 0x1005, 4, std::string("abc\0", 4)),
                    Words(0x9999, {1}), Words(0x2101, {0x3102})}),
              table);
    ovo::StereoProfileFields fields;
    ovo::ApplyProfileItems(fields, table);
    EXPECT_EQ(fields.m_eye_distance, -0.035f);
    EXPECT_EQ(fields.m_eye_distance_set, -0.035f);
    EXPECT_EQ(fields.m_eye_shift, 0.01f);
    EXPECT_EQ(fields.m_eye_shift_set, 0.01f);
    EXPECT_EQ(fields.m_eye_angle, -0.05f);
    EXPECT_EQ(fields.m_eye_angle_set, -0.05f);
    EXPECT_EQ(fields.m_ramp_steps, 2.0f);
    EXPECT_EQ(fields.m_eye_axis, 0x3002u);
    EXPECT_EQ(fields.m_ramp_param, 0x3003u);
    EXPECT_EQ(fields.m_split, 0x3102u) << "the later of two items with one id wins";
    EXPECT_EQ(fields.m_eye_order, 0x3107u);
    EXPECT_EQ(fields.m_ramp, 0x3202u);
    EXPECT_EQ(fields.m_target_width, 800);
    EXPECT_EQ(fields.m_target_height, 480);
    EXPECT_EQ(fields.m_screen_width, 1024);
    EXPECT_EQ(fields.m_screen_height, 600);
    EXPECT_TRUE(fields.m_shader_convert) << "a flag is word 0 != 0";
    EXPECT_TRUE(fields.m_use_screen_size);
    EXPECT_TRUE(fields.m_auto_eye);
    EXPECT_TRUE(fields.m_eye_target);
    EXPECT_TRUE(fields.m_valid);
    // Nothing else moves: no item sets these.
    EXPECT_EQ(fields.m_width, 0);
    EXPECT_EQ(fields.m_height, 0);
    EXPECT_FALSE(fields.m_enabled);
    EXPECT_EQ(fields.m_mode, 0u);
    EXPECT_EQ(fields.m_shift_axis, 0x3001u);
    EXPECT_TRUE(fields.m_swap_eye_mask);
    EXPECT_EQ(fields.m_ramp_restart, 10.0f);
    EXPECT_FALSE(fields.m_force_portrait);
}

TEST(ProfileFileTest, TheEffectDependsOnTheIdNotOnTheType) {
    ProfileTable table;
    // A text payload read as word 0 (host order), and an item without payload (word 0 is 0).
    ReadBytes(File({Item(0x2403, 0x1005, 1, "\x01"), Item(0x2001, 0x0042, 0)}), table);
    ovo::StereoProfileFields fields;
    fields.m_eye_distance = 5.0f;
    ovo::ApplyProfileItems(fields, table);
    EXPECT_TRUE(fields.m_valid);
    EXPECT_EQ(fields.m_eye_distance, 0.0f);
}

}  // namespace
