#ifndef OVO_EXAMPLES_LIFECYCLE_TEXTURE_LOADER_H
#define OVO_EXAMPLES_LIFECYCLE_TEXTURE_LOADER_H

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <mutex>
#include <thread>

#include "common/pbuffer_context.h"

namespace ovo_sample {

// A game's loading thread: a context of its own (of the game's version) that shares the
// game's objects, on a 1 x 1 pbuffer, uploads textures while the game's thread draws, one
// after each frame the game reports, and hands each over when it is complete. Its EGL
// calls that change what is current come between two of the game's frames, with the game
// waiting: a stereo library may act on them (the overlay does), and only so is a run's
// outcome the same every time.
class TextureLoader {
public:
    // The number of textures it loads.
    static constexpr int32_t TEXTURE_COUNT = 4;

    // Starts the thread; its context is made there, sharing `game`'s.
    void Start(const PbufferContext& game);
    // The game's thread drew a frame; it waits here while the loading thread changes what
    // is current.
    void FrameDrawn();
    // Whether the thread has loaded everything, or given up.
    bool Done();
    // The oldest loaded texture not yet taken; false when there is none.
    bool Take(uint32_t* texture);
    // Stops the thread and waits for it; false when it failed (it said why).
    bool Finish();

private:
    void Load(const PbufferContext& game);
    // Waits until the game drew more than `frames` frames; false when told to stop.
    bool WaitForFrames(int32_t frames);
    void Hand(uint32_t texture);
    // Returns once the game waits between two frames (or is told to stop).
    void PauseGame();
    void ResumeGame();

    std::thread m_thread;
    std::mutex m_lock;
    std::condition_variable m_changed;
    int32_t m_frames_drawn = 0;
    bool m_pause_wanted = false;
    bool m_game_paused = false;
    bool m_stop = false;
    bool m_done = false;
    bool m_ok = false;
    std::deque<uint32_t> m_loaded;
};

}  // namespace ovo_sample

#endif
