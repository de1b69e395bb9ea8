// Which contexts share their objects, and which share group ends with which context.
#include <gtest/gtest.h>

#include <cstdint>
#include <utility>
#include <vector>

#include "egl/context_registry.h"

namespace {

EGLDisplay Display(uintptr_t n) { return reinterpret_cast<EGLDisplay>(n); }
EGLContext Context(uintptr_t n) { return reinterpret_cast<EGLContext>(n); }

TEST(ContextRegistryTest, SharingContextsShareAGroupThatEndsWithTheLastOfThem) {
    ovo::ContextRegistry registry;
    registry.NoteCreated(Display(1), Context(10), EGL_NO_CONTEXT, 1);
    registry.NoteCreated(Display(1), Context(11), Context(10), 1);
    registry.NoteCreated(Display(1), Context(12), EGL_NO_CONTEXT, 1);
    // Sharing with a context the library never saw starts a group of its own.
    registry.NoteCreated(Display(1), Context(13), Context(99), 1);
    const uint32_t first = registry.ShareGroupOf(Context(10));
    EXPECT_NE(first, ovo::SHARE_GROUP_NONE);
    EXPECT_EQ(registry.ShareGroupOf(Context(11)), first);
    EXPECT_NE(registry.ShareGroupOf(Context(12)), first);
    EXPECT_NE(registry.ShareGroupOf(Context(13)), registry.ShareGroupOf(Context(12)));
    EXPECT_EQ(registry.ShareGroupOf(Context(99)), ovo::SHARE_GROUP_NONE);

    EXPECT_EQ(registry.NoteDestroyed(Display(2), Context(10)), ovo::SHARE_GROUP_NONE)
        << "a context of another display";
    EXPECT_EQ(registry.NoteDestroyed(Display(1), Context(10)), ovo::SHARE_GROUP_NONE);
    EXPECT_EQ(registry.ShareGroupOf(Context(11)), first);
    EXPECT_EQ(registry.NoteDestroyed(Display(1), Context(11)), first);
    EXPECT_EQ(registry.NoteDestroyed(Display(1), Context(11)), ovo::SHARE_GROUP_NONE)
        << "destroyed twice";
    // A handle the driver gives out again is a new context, in a new group.
    registry.NoteCreated(Display(1), Context(11), EGL_NO_CONTEXT, 1);
    EXPECT_NE(registry.ShareGroupOf(Context(11)), first);
}

TEST(ContextRegistryTest, TerminatingADisplayEndsTheGroupsOfItsContextsOnly) {
    ovo::ContextRegistry registry;
    registry.NoteCreated(Display(1), Context(10), EGL_NO_CONTEXT, 1);
    registry.NoteCreated(Display(1), Context(11), Context(10), 0);
    registry.NoteCreated(Display(1), Context(12), EGL_NO_CONTEXT, 1);
    registry.NoteCreated(Display(2), Context(20), EGL_NO_CONTEXT, 1);
    // Each group's objects go with one of its contexts: the last listed.
    ovo::ContextFacts listed[ovo::CONTEXT_REGISTRY_CAPACITY];
    ASSERT_EQ(registry.ContextsOf(Display(1), listed), 3u);
    const std::vector<std::pair<EGLContext, bool>> ends = {
        {listed[0].m_context, listed[0].m_ends_group}, {listed[1].m_context, listed[1].m_ends_group},
        {listed[2].m_context, listed[2].m_ends_group}};
    EXPECT_EQ(ends, (std::vector<std::pair<EGLContext, bool>>{
                        {Context(10), false}, {Context(11), true}, {Context(12), true}}));
    EXPECT_EQ(listed[1].m_client_api_index, 0u);
    ovo::ContextFacts facts{};
    ASSERT_TRUE(registry.Lookup(Display(1), Context(10), &facts));
    EXPECT_FALSE(facts.m_ends_group) << "11 shares its group";
    EXPECT_EQ(facts.m_client_api_index, 1u);
    EXPECT_FALSE(registry.Lookup(Display(2), Context(10), &facts)) << "of another display";
    const std::vector<uint32_t> expected = {registry.ShareGroupOf(Context(10)),
                                            registry.ShareGroupOf(Context(12))};
    std::vector<uint32_t> ended;
    registry.NoteTerminated(Display(1), [&](uint32_t group) { ended.push_back(group); });
    EXPECT_EQ(ended, expected);
    EXPECT_EQ(registry.ShareGroupOf(Context(11)), ovo::SHARE_GROUP_NONE);
    EXPECT_NE(registry.ShareGroupOf(Context(20)), ovo::SHARE_GROUP_NONE);
}

// More live contexts than the table holds: the ones past it have no known group, and a
// freed slot takes the next one.
TEST(ContextRegistryTest, ContextsPastTheCapacityHaveNoGroup) {
    ovo::ContextRegistry registry;
    const uintptr_t count = ovo::CONTEXT_REGISTRY_CAPACITY;
    for (uintptr_t n = 1; n <= count + 1; ++n) registry.NoteCreated(Display(1), Context(n), EGL_NO_CONTEXT, 1);
    EXPECT_NE(registry.ShareGroupOf(Context(count)), ovo::SHARE_GROUP_NONE);
    EXPECT_EQ(registry.ShareGroupOf(Context(count + 1)), ovo::SHARE_GROUP_NONE);
    registry.NoteDestroyed(Display(1), Context(1));
    registry.NoteCreated(Display(1), Context(count + 1), EGL_NO_CONTEXT, 1);
    EXPECT_NE(registry.ShareGroupOf(Context(count + 1)), ovo::SHARE_GROUP_NONE);
}

}  // namespace
