#include <gtest/gtest.h>

#include <cstdarg>
#include <string>

#include "config/debug_log.h"
#include "debug_test_files.h"

namespace {

using ovo::DebugLog;

const char LOG_PATH[] = "/sdcard/logs/test.log";
const char FALLBACK_PATH[] = "/data/duoscope/debug.log";

using VPrintOperation = void (DebugLog::*)(const char*, va_list);

void CallVPrint(DebugLog& log, VPrintOperation operation, const char* prefix, const char* format, ...) {
    va_list arguments;
    va_start(arguments, format);
    if (operation != nullptr) {
        (log.*operation)(format, arguments);
    } else {
        log.VPrintTagged(prefix, format, arguments);
    }
    va_end(arguments);
}

// Every write operation once, through the base class as the library calls them.
void WriteEverything(DebugLog& log) {
    const VPrintOperation operations[] = {&DebugLog::VPrint0, &DebugLog::VPrint1, &DebugLog::VPrint2,
                                          &DebugLog::VPrint3};
    for (int i = 0; i < 4; ++i) CallVPrint(log, operations[i], nullptr, "v%d=%s;", i, "x");
    CallVPrint(log, nullptr, "[tag] ", "%05.1f", 2.5);
    log.Write("|text%d");
}

TEST(FileDebugLog, WritesToTheFileOrTheFallbackOrNowhere) {
    const std::string everything = "v0=x;v1=x;v2=x;v3=x;[tag] 002.5|text%d";
    const struct {
        const char* path;
        bool fallback_folder;
        const char* log_path;  // where the text must land; null: nowhere
    } cases[] = {
        {LOG_PATH, true, LOG_PATH},
        {"/sdcard/logs/missing/test.log", true, FALLBACK_PATH},
        {"/sdcard/logs", true, FALLBACK_PATH},
        {"/sdcard/logs/missing/test.log", false, nullptr},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.path);
        RemoveDeviceTrees({"/sdcard/logs", "/data/duoscope"});
        WriteDeviceFile(LOG_PATH, "from the last run");
        if (test.fallback_folder) WriteDeviceFile(FALLBACK_PATH, "old");

        testing::internal::CaptureStderr();
        DebugLog* log = new ovo::FileDebugLog(test.path);
        WriteEverything(*log);
        delete log;  // closes the file, which flushes it
        std::string reported = testing::internal::GetCapturedStderr();

        EXPECT_EQ(ReadDeviceFile(LOG_PATH), test.log_path == LOG_PATH ? everything : "from the last run");
        EXPECT_EQ(ReadDeviceFile(FALLBACK_PATH), test.log_path == FALLBACK_PATH ? everything
                                                 : test.fallback_folder       ? "old"
                                                                              : "<missing>");
        const std::string failed = "I/ZVT: stream(0x00000000) = fopen(path=";
        std::string first = failed + RootPath(test.path) + ", attrib=wt)\n";
        std::string second = failed + RootPath(FALLBACK_PATH) + ", attrib=wt)\n";
        if (test.log_path == nullptr) {
            EXPECT_EQ(reported, first + "\n" + second + "\n");
        } else {
            EXPECT_EQ(reported.find(test.log_path == LOG_PATH ? first : second), std::string::npos);
        }
    }
}

}  // namespace
