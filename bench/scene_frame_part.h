#ifndef OVO_BENCH_SCENE_FRAME_PART_H
#define OVO_BENCH_SCENE_FRAME_PART_H

// A sample scene on Mesa through the library, flat or in stereo.
struct SceneCase {
    const char* m_name;     // the part's name and its benchmark's name
    const char* m_module;   // the sample's scene module (stereo_scene_frames.h)
    const char* m_profile;  // the binary profile installed first; null: none (flat)
};

// In this process, before any other use of the library: installs the case's profile (or
// removes any), starts the scene through the library on Mesa and registers the case's
// benchmark, one frame (draw, swap, finish) per iteration. False after printing why.
bool RegisterSceneBenchmark(const SceneCase& scene_case);

#endif
