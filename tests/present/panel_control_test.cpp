#include "present/panel_control.h"

#include <gtest/gtest.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <filesystem>
#include <iterator>

#include "support/device_files.h"

namespace {

TEST(PanelControlTest, EachModeReachesThePanelNodeByValue) {
    device_files::Write("/dev/zpx", "");
    EXPECT_TRUE(ovo::SetPanelMode(false, true));
    EXPECT_TRUE(ovo::SetPanelMode(true, true));
    EXPECT_TRUE(ovo::SetPanelMode(true, false));
    EXPECT_EQ(device_files::Read("/dev/zpx"),
              "request=0xc0047602 argument=0\n"
              "request=0xc0047602 argument=1\n"
              "request=0xc0047602 argument=2\n");
}

TEST(PanelControlTest, CompositionStartSendsOneAndMissingNodesAreSilent) {
    device_files::Write("/dev/zdriver", "");
    ovo::SendCompositionStart();
    EXPECT_EQ(device_files::Read("/dev/zdriver"), "request=0x616 argument=1\n");
    device_files::Remove("/dev/zpx");
    device_files::Remove("/dev/zdriver");
    EXPECT_FALSE(ovo::SetPanelMode(true, true));
    ovo::SendCompositionStart();
    EXPECT_FALSE(std::filesystem::exists(device_files::Path("/dev/zpx")));
    EXPECT_FALSE(std::filesystem::exists(device_files::Path("/dev/zdriver")));
}

size_t OpenDescriptors() {
    return static_cast<size_t>(std::distance(std::filesystem::directory_iterator("/proc/self/fd"),
                                             std::filesystem::directory_iterator()));
}

// The panel is asked again about ten times a second for as long as the game runs.
TEST(PanelControlTest, EveryPanelRequestClosesItsNode) {
    device_files::Write("/dev/zpx", "");
    const size_t before = OpenDescriptors();
    for (int request = 0; request < 50; ++request) ASSERT_TRUE(ovo::SetPanelMode(true, request % 2 == 0));
    EXPECT_EQ(OpenDescriptors(), before);
}

// The stand-in answers only for its plain-file nodes; everything else reaches the real ioctl.
TEST(PanelControlTest, OtherDescriptorsReachTheRealDriver) {
    int channel[2];
    ASSERT_EQ(pipe(channel), 0);
    ASSERT_EQ(write(channel[1], "abc", 3), 3);
    int pending = 0;
    EXPECT_EQ(ioctl(channel[0], FIONREAD, &pending), 0);
    EXPECT_EQ(pending, 3);
    close(channel[0]);
    close(channel[1]);
}

}  // namespace
