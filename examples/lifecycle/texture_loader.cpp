#include "lifecycle/texture_loader.h"

// Only calls that OpenGL ES 1.1 and 2.0 share.
#include <GLES2/gl2.h>

#include <cstdio>

#include "common/frame_capture.h"
#include "common/gl_texture.h"
#include "common/rgba_image.h"

namespace ovo_sample {

namespace {

constexpr int32_t LOADED_SIZE = 64;
constexpr int32_t LOADED_CELL = 8;

// Each texture's two checker colours: every one tells itself apart in the scene.
constexpr Rgba LOADED_COLORS[TextureLoader::TEXTURE_COUNT][2] = {
    {{240, 120, 100, 255}, {60, 40, 30, 255}},
    {{120, 220, 120, 255}, {30, 70, 40, 255}},
    {{230, 210, 110, 255}, {90, 60, 140, 255}},
    {{200, 200, 235, 255}, {150, 70, 40, 255}},
};

}  // namespace

void TextureLoader::Start(const PbufferContext& game) {
    m_thread = std::thread([this, &game] { Load(game); });
}

void TextureLoader::Load(const PbufferContext& game) {
    PbufferContext own;
    own.BorrowDisplay(game);
    PauseGame();
    bool ok = own.CreateSurface(1, 1) && own.CreateContext(game.Context()) && own.MakeCurrent();
    ResumeGame();
    for (int32_t index = 0; ok && index < TEXTURE_COUNT; ++index) {
        ok = WaitForFrames(index);
        if (!ok) break;
        const RgbaImage image = MakeCheckerboard(LOADED_SIZE, LOADED_CELL,
                                                 LOADED_COLORS[index][0], LOADED_COLORS[index][1]);
        const uint32_t texture = CreateTexture(image, {GL_LINEAR, GL_LINEAR, GL_REPEAT, GL_REPEAT});
        glBindTexture(GL_TEXTURE_2D, 0);
        // Complete before another context draws with it.
        glFinish();
        Hand(texture);
    }
    const uint32_t error = TakeGlError();
    if (error != 0) std::fprintf(stderr, "loading thread: GL error 0x%04X\n", error);
    PauseGame();
    ok = own.Destroy() && ok && error == 0;
    ResumeGame();
    std::lock_guard<std::mutex> hold(m_lock);
    m_ok = ok;
    m_done = true;
}

bool TextureLoader::WaitForFrames(int32_t frames) {
    std::unique_lock<std::mutex> hold(m_lock);
    m_changed.wait(hold, [&] { return m_stop || m_frames_drawn > frames; });
    return !m_stop;
}

void TextureLoader::Hand(uint32_t texture) {
    std::lock_guard<std::mutex> hold(m_lock);
    m_loaded.push_back(texture);
}

void TextureLoader::FrameDrawn() {
    std::unique_lock<std::mutex> hold(m_lock);
    ++m_frames_drawn;
    m_game_paused = m_pause_wanted;
    m_changed.notify_all();
    m_changed.wait(hold, [&] { return !m_pause_wanted; });
    m_game_paused = false;
}

void TextureLoader::PauseGame() {
    std::unique_lock<std::mutex> hold(m_lock);
    m_pause_wanted = true;
    m_changed.wait(hold, [&] { return m_game_paused || m_stop; });
}

void TextureLoader::ResumeGame() {
    {
        std::lock_guard<std::mutex> hold(m_lock);
        m_pause_wanted = false;
    }
    m_changed.notify_all();
}

bool TextureLoader::Done() {
    std::lock_guard<std::mutex> hold(m_lock);
    return m_done;
}

bool TextureLoader::Take(uint32_t* texture) {
    std::lock_guard<std::mutex> hold(m_lock);
    if (m_loaded.empty()) return false;
    *texture = m_loaded.front();
    m_loaded.pop_front();
    return true;
}

bool TextureLoader::Finish() {
    {
        std::lock_guard<std::mutex> hold(m_lock);
        m_stop = true;
    }
    m_changed.notify_all();
    if (m_thread.joinable()) m_thread.join();
    std::lock_guard<std::mutex> hold(m_lock);
    return m_ok;
}

}  // namespace ovo_sample
