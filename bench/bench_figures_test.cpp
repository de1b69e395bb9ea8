// The figures' way from a part's process to the summary, and the flags that make a process
// a part.
#include <gtest/gtest.h>

#include <vector>

#include "bench_figures.h"
#include "part_process.h"

TEST(BenchFigures, KeepSixDigitsThroughTheirText) {
    const BenchFigureTable sent = {{"es1_shader/direct", {5.1234567, 7.25, 0.0}},
                                   {"es1_scene/stereo", {12345678.9, 2.5e7, 0.0}},
                                   {"rewriter/corpus", {9.5e5, 9.75e5, 123456789.0}}};
    BenchFigureTable received = {{"es1_plain/library", {80.0, 120.0, 0.0}}};
    ASSERT_TRUE(ParseFigures(FormatFigures(sent), &received));
    ASSERT_EQ(received.size(), 4u);
    EXPECT_DOUBLE_EQ(received["es1_shader/direct"].m_cpu_ns, 5.12346);
    EXPECT_DOUBLE_EQ(received["es1_shader/direct"].m_real_ns, 7.25);
    EXPECT_DOUBLE_EQ(received["es1_scene/stereo"].m_cpu_ns, 12345700.0);
    EXPECT_DOUBLE_EQ(received["rewriter/corpus"].m_bytes_per_second, 123457000.0);
    EXPECT_DOUBLE_EQ(received["es1_plain/library"].m_real_ns, 120.0);
}

TEST(BenchFigures, TurnDownMalformedLines) {
    const char* const malformed[] = {"es1_shader/direct 5.0 6\n", "es1_shader/direct five 6 0\n",
                                     "es1_shader/direct 5 6 0\n\n", "5 6 0\n"};
    for (const char* text : malformed) {
        BenchFigureTable figures;
        EXPECT_FALSE(ParseFigures(text, &figures)) << text;
    }
}

TEST(PartFlags, AreTakenOnlyInFrontOfTheUsersFlags) {
    struct Case {
        std::vector<const char*> m_arguments;
        bool m_part;
        int m_argc_after;
    } cases[] = {
        {{"bench", "--ovo_part=sprite", "--ovo_figures_fd=7", "--benchmark_min_time=1"}, true, 2},
        {{"bench", "--ovo_part=sprite", "--ovo_figures_fd=7"}, true, 1},
        {{"bench", "--ovo_figures_fd=7", "--ovo_part=sprite"}, false, 3},
        {{"bench", "--benchmark_min_time=1", "--ovo_part=sprite", "--ovo_figures_fd=7"}, false, 4},
        {{"bench"}, false, 1},
    };
    for (Case& c : cases) {
        std::vector<char*> argv;
        for (const char* argument : c.m_arguments) argv.push_back(const_cast<char*>(argument));
        argv.push_back(nullptr);
        int argc = static_cast<int>(c.m_arguments.size());
        PartFlags flags;
        EXPECT_EQ(TakePartFlags(&argc, argv.data(), &flags), c.m_part) << c.m_arguments.back();
        EXPECT_EQ(argc, c.m_argc_after);
        EXPECT_EQ(argv[argc], nullptr);
        if (c.m_part) {
            EXPECT_EQ(flags.m_part, "sprite");
            EXPECT_EQ(flags.m_figures_fd, 7);
            if (argc == 2) {
                EXPECT_STREQ(argv[1], "--benchmark_min_time=1");
            }
        }
    }
}
