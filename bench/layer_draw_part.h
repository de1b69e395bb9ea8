#ifndef OVO_BENCH_LAYER_DRAW_PART_H
#define OVO_BENCH_LAYER_DRAW_PART_H

#include <cstdint>

// The game the recording vendor plays along with: its OpenGL ES version and what the
// vendor answers the layer's queries.
enum LayerGame : uint8_t {
    // OpenGL ES 1.x with GL's initial identity projection, flat as a 2D game's
    // orthographic projection is.
    LAYER_GAME_ES1_FLAT,
    // OpenGL ES 1.x with the sample scene's perspective projection: a 3D game.
    LAYER_GAME_ES1_PERSPECTIVE,
    // OpenGL ES 2.0 with a program whose vertex shader declares the depth-shift uniform.
    LAYER_GAME_ES2,
};

// The application's draw call that is timed.
enum LayerDrawCall : uint8_t {
    LAYER_DRAW_ARRAYS,    // glDrawArrays
    LAYER_DRAW_ELEMENTS,  // glDrawElements
};

// How the layer in use, and the path it takes, show on the recording vendor per
// application draw: the vendor's draws, its per-eye setups (translations of the projection
// in OpenGL ES 1.x, values of the depth-shift uniform in 2.0), and whether the texture
// matrix is read (only the sprite layer reads it).
struct LayerSignature {
    uint32_t m_vendor_draws;
    uint32_t m_eye_setups;
    bool m_reads_texture_matrix;
};

// One stereo layer and draw call, the layer chosen by a profile and the process name.
struct LayerCase {
    const char* m_name;          // the part's name and its benchmarks' prefix
    const char* m_process_name;  // what the process is called; null: this program's name
    const char* m_profile;       // the binary profile that selects the layer
    const char* m_layer;         // the layer's class, for the summary
    LayerGame m_game;
    LayerDrawCall m_draw_call;
    LayerSignature m_signature;
};

// The draw call's GL name, for the summary.
const char* LayerDrawCallName(LayerDrawCall draw_call);

// In this process, before any other use of the library: installs the case's profile, makes
// a context of the game's OpenGL ES version current through the library on the recording
// vendor with an 800x480 viewport, checks the signature of the case's layer and path,
// switches the vendor to doing nothing but answer, and registers NAME/direct (the vendor's
// draw call called directly) and NAME/library (the draw call through the library's
// export). False after printing why.
bool RegisterLayerBenchmarks(const LayerCase& layer_case);

#endif
