#include <gtest/gtest.h>

#include <cstdarg>
#include <filesystem>
#include <memory>
#include <regex>
#include <string>

#include "config/debug_config.h"
#include "support/device_files.h"

namespace {

const char LOG_PATH[] = "/sdcard/x.log";
const char FALLBACK_PATH[] = "/data/duoscope/debug.log";

// Stale logs that a writer must truncate, and no configuration.
void ResetDeviceFiles(bool fallback_folder = true) {
    for (const char* folder : {"/sdcard", "/data/duoscope"})
        std::filesystem::remove_all(device_files::Path(folder));
    device_files::Write(LOG_PATH, "old");
    if (fallback_folder) device_files::Write(FALLBACK_PATH, "old");
}

std::string Configuration(const std::string& root_attributes, const std::string& enable,
                          const std::string& output = "<output filename=\"/sdcard/x.log\"/>") {
    return "<?xml version=\"1.0\"?>\n<duoscope " + root_attributes + ">\n  <debug enable=\"" +
           enable + "\">" + output + "</debug>\n</duoscope>\n";
}

TEST(DebugConfig, WritesTheLogOnlyWhenSwitchedOn) {
    const std::string on = "version=\"1.0\"";
    const struct {
        std::string file;      // empty: no configuration file
        const char* log_path;  // where the lines must land; null: nowhere
    } cases[] = {
        {Configuration(on, "true"), LOG_PATH},
        {Configuration("a=\"b\" " + on, "true"), LOG_PATH},
        {Configuration(on, "true", "<output/>"), FALLBACK_PATH},
        {"", nullptr},
        {"<?xml version=\"1.0\"?>", nullptr},  // no element at all
        {Configuration("version=\"1.1\"", "true"), nullptr},
        {Configuration(on, "TRUE"), nullptr},
        {"<other " + on + "/>" + Configuration(on, "true"), nullptr},  // duoscope must come first
        {"<debug " + on + "/>" + Configuration(on, "true"), nullptr},
        {"<a/> / " + Configuration(on, "true"), nullptr},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.file);
        ResetDeviceFiles();
        if (!test.file.empty()) device_files::Write("/sdcard/duoscope/dconfig.xml", test.file);
        {
            ovo::DebugConfig config;
            config.Print("%04d : eye_distance(%f)", 7, 1.5);
            config.Print("|%s", "next");
        }
        const std::string lines = "0007 : eye_distance(1.500000)|next";
        EXPECT_EQ(device_files::Read(LOG_PATH), test.log_path == LOG_PATH ? lines : "old");
        EXPECT_EQ(device_files::Read(FALLBACK_PATH), test.log_path == FALLBACK_PATH ? lines : "old");
    }
}

using ovo::DebugLog;
using VPrint = void (DebugLog::*)(const char*, va_list);
// Null stands for VPrintTagged.
const VPrint EVERY_VPRINT[] = {&DebugLog::VPrint0, &DebugLog::VPrint1, &DebugLog::VPrint2,
                               &DebugLog::VPrint3, nullptr};

void Call(DebugLog& log, VPrint operation, ...) {
    va_list arguments;
    va_start(arguments, operation);
    operation ? (log.*operation)("%d;", arguments) : log.VPrintTagged("[tag] ", "%d;", arguments);
    va_end(arguments);
}

TEST(FileDebugLog, WritesToTheFileOrTheFallbackOrNowhere) {
    const char* missing = "/sdcard/missing/x.log";
    const std::string text = "5;5;5;5;[tag] 5;%d";
    const struct {
        const char* path;
        bool fallback_folder;
        std::string log, fallback;  // the files' content afterwards
        std::string opens;  // one per open line: 'o' a stream, '0' none
    } cases[] = {{LOG_PATH, true, text, "old", "o"}, {missing, true, "old", text, "0o"},
                 {missing, false, "old", "<missing>", "00"}};
    for (const auto& test : cases) {
        ResetDeviceFiles(test.fallback_folder);
        testing::internal::CaptureStderr();
        std::unique_ptr<DebugLog> log(new ovo::FileDebugLog(test.path));
        const std::string lines = std::regex_replace(testing::internal::GetCapturedStderr(),
                                                     std::regex("stream\\(0x(?!00000000)[0-9a-f]{8}\\)"), "stream(ok)");
        std::string expected;
        for (size_t i = 0; i < test.opens.size(); ++i) {
            expected += std::string("I/ZVT: stream(") + (test.opens[i] == 'o' ? "ok" : "0x00000000") +
                        ") = fopen(path=" + device_files::Path(i == 0 ? test.path : FALLBACK_PATH) + ", attrib=wt)\n\n";
        }
        EXPECT_EQ(lines, expected);
        for (VPrint operation : EVERY_VPRINT) Call(*log, operation, 5);
        log->Write("%d");
        log.reset();  // closes the file, which flushes it
        EXPECT_EQ(device_files::Read(LOG_PATH), test.log) << test.path;
        EXPECT_EQ(device_files::Read(FALLBACK_PATH, "<missing>"), test.fallback) << test.path;
    }
}

}  // namespace
