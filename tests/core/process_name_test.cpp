// The manager takes the application's name from the first argument of its command line.
#include <gtest/gtest.h>

#include <cstdio>
#include <string>

#include "core/stereo_manager.h"
#include "support/scenario_process.h"

namespace {

TEST(ProcessNameTest, DISABLED_PrintName) {
    char name[ovo::PROCESS_NAME_CAPACITY];
    ovo::StereoManager::ReadProcessName(name);
    std::printf("name=[%s]\n", name);
}

TEST(ProcessNameTest, IsTheFirstArgumentCutAtWhitespace) {
    struct Case {
        std::string m_command_line;
        std::string m_expected;
    } cases[] = {
        {"com.example.game", "com.example.game"},
        {"app --flag", "app"},
        {"tab\tseparated", "tab"},
        {std::string(2000, 'n'), std::string(ovo::PROCESS_NAME_CAPACITY - 1, 'n')},
    };
    for (const Case& each : cases) {
        ScenarioResult result =
            RunScenario(each.m_command_line.c_str(), "ProcessNameTest.DISABLED_PrintName");
        EXPECT_EQ(result.m_exit_code, 0);
        EXPECT_NE(result.m_output.find("name=[" + each.m_expected + "]\n"), std::string::npos)
            << result.m_output.substr(0, 200);
    }
}

}  // namespace
