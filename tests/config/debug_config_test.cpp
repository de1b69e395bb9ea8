#include <gtest/gtest.h>

#include <string>

#include "config/debug_config.h"
#include "debug_test_files.h"

namespace {

const char LOG_PATH[] = "/sdcard/x.log";
const char FALLBACK_PATH[] = "/data/duoscope/debug.log";

TEST(DebugConfig, KeywordTableHoldsTheConfigurationNames) {
    RemoveDeviceTrees({"/sdcard"});
    ovo::DebugConfig config;
    const char* names[] = {"duoscope", "debug", "output", "version", "enable", "filename"};
    const int32_t codes[] = {0x1000, 0x1001, 0x1002, 0x3000, 0x3001, 0x3002};
    ASSERT_EQ(config.m_count, 6);
    for (int32_t i = 0; i < 6; ++i) {
        EXPECT_STREQ(config.m_keywords[i].m_name, names[i]);
        EXPECT_EQ(config.LookUpKeyword(names[i]), codes[i]);
    }
    for (const char* unknown : {"Duoscope", "debu", "debugs", "", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(config.LookUpKeyword(unknown), 0) << (unknown ? unknown : "null");
    }
}

std::string Configuration(const std::string& root_attributes, const std::string& enable,
                          const std::string& output) {
    return "<?xml version=\"1.0\"?>\n<!-- debug switch -->\n<duoscope " + root_attributes +
           ">\n  <debug enable=\"" + enable + "\">\n    " + output + "\n  </debug>\n</duoscope>\n";
}

TEST(DebugConfig, WritesTheLogOnlyWhenSwitchedOn) {
    const std::string output = "<output filename=\"/sdcard/x.log\"/>";
    const std::string on = "version=\"1.0\"";
    const struct {
        const char* what;
        std::string file;  // empty: no configuration file
        const char* log_path;  // where the lines must land; null: nowhere
    } cases[] = {
        {"working configuration", Configuration(on, "true", output), LOG_PATH},
        {"version after another attribute", Configuration("a=\"b\" " + on, "true", output), LOG_PATH},
        {"no filename", Configuration(on, "true", "<output/>"), FALLBACK_PATH},
        {"unwritable filename", Configuration(on, "true", "<output filename=\"/sdcard/no/x\"/>"),
         FALLBACK_PATH},
        {"no configuration file", "", nullptr},
        {"version 1.1", Configuration("version=\"1.1\"", "true", output), nullptr},
        {"enable TRUE", Configuration(on, "TRUE", output), nullptr},
        {"other top-level element",
         "<config " + on + "><debug enable=\"true\">" + output + "</debug></config>", nullptr},
        {"duoscope not first", "<other/>" + Configuration(on, "true", output), nullptr},
        {"unparsable file", "<a/> / " + Configuration(on, "true", output), nullptr},
    };
    const std::string lines =
        "0007 : eye_distance(1.500000), eye_angle(-0.250000)"
        "0008 : eye_distance(2.000000), eye_angle(0.500000)";
    for (const auto& test : cases) {
        SCOPED_TRACE(test.what);
        RemoveDeviceTrees({"/sdcard", "/data/duoscope"});
        WriteDeviceFile(FALLBACK_PATH, "old");
        WriteDeviceFile("/sdcard/duoscope/dconfig.xml", test.file);
        if (test.file.empty()) RemoveDeviceTrees({"/sdcard/duoscope/dconfig.xml"});
        {
            ovo::DebugConfig config;
            config.Print("%04d : eye_distance(%f), eye_angle(%f)", 7, 1.5, -0.25);
            config.Print("%04d : eye_distance(%f), eye_angle(%f)", 8, 2.0, 0.5);
        }
        EXPECT_EQ(ReadDeviceFile(LOG_PATH), test.log_path == LOG_PATH ? lines : "<missing>");
        EXPECT_EQ(ReadDeviceFile(FALLBACK_PATH), test.log_path == FALLBACK_PATH ? lines : "old");
    }
}

}  // namespace
