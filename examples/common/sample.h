#ifndef OVO_EXAMPLES_SAMPLE_H
#define OVO_EXAMPLES_SAMPLE_H

// What each sample program provides; the shared main creates an EGL pbuffer context of
// the sample's client version, draws its frames with a swap after each, and writes the
// last frame as a PNG.
struct Sample {
    const char* m_name;
    int m_client_version;
    bool (*m_set_up)(int width, int height);
    void (*m_draw_frame)(int frame);
};

extern const Sample SAMPLE;

constexpr int SAMPLE_WIDTH = 320;
constexpr int SAMPLE_HEIGHT = 240;

#endif
