#ifndef OVO_BENCH_LAYER_DRAW_PART_H
#define OVO_BENCH_LAYER_DRAW_PART_H

#include <cstdint>

// How the layer in use, and the path it takes, show on the recording vendor per
// application draw: the vendor's draws, its translations of the projection, and whether
// the texture matrix is read (only the sprite layer reads it).
struct LayerSignature {
    uint32_t m_vendor_draws;
    uint32_t m_translations;
    bool m_reads_texture_matrix;
};

// One OpenGL ES 1.x layer, chosen by a profile and the process name.
struct LayerCase {
    const char* m_name;          // the part's name and its benchmarks' prefix
    const char* m_process_name;  // what the process is called; null: this program's name
    const char* m_profile;       // the binary profile that selects the layer
    const char* m_layer;         // the layer's class, for the summary
    // The vendor answers a 3D game's perspective projection; otherwise GL's initial identity,
    // which is flat as a 2D game's orthographic projection is.
    bool m_perspective;
    LayerSignature m_signature;
};

// In this process, before any other use of the library: installs the case's profile, makes
// an OpenGL ES 1.x context current through the library on the recording vendor with an
// 800x480 viewport, checks the signature of the case's layer and path, switches the vendor
// to doing nothing but answer, and registers NAME/direct (the vendor's glDrawArrays called
// directly) and NAME/library (glDrawArrays through the library's export). False after
// printing why.
bool RegisterLayerBenchmarks(const LayerCase& layer_case);

#endif
