#ifndef OVO_TESTS_PROGRAMS_STEREO_FRAME_CHECKS_H
#define OVO_TESTS_PROGRAMS_STEREO_FRAME_CHECKS_H

#include "rgba_frame.h"
#include "third_party_programs.h"

// A span of horizontal shifts, in eye pixels (a column of one eye's de-interleaved image).
struct ShiftSpan {
    float m_lowest;
    float m_highest;
};

// Where the profile lets things move: each eye against the native frame, and the eyes
// against each other (the disparity x_eye1 - x_eye0), whatever a vertex's depth.
struct DisparityPrediction {
    ShiftSpan m_eyes[2];
    ShiftSpan m_disparity;
};

// The depth shift moves a vertex at normalised depth z by d x min(a - z, 0) in eye 0 and
// by -d x min(-a - z, 0) in eye 1 (clip-space x; d the eye distance, a the eye angle): eye
// 0 only ever moves left and eye 1 right, 0 (z <= -a) to 2 d (z = 1) apart. Clip space is
// `window_width` / 2 screen pixels per unit, and an eye pixel is two screen pixels.
DisparityPrediction PredictDisparity(float eye_distance, float eye_angle, int window_width);

// An OpenGL ES 1.x flat draw moves by the eye shift s in clip space, eye 0 right and eye 1
// left: each eye s, the eyes 2 s apart, in front of the screen.
DisparityPrediction PredictFlatShift(float eye_shift, int window_width);

// How far apart a frame's eyes lie, in eye pixels: the largest separation measured, and
// the largest departure from none (both 0 when nothing could be measured).
struct FrameDepth {
    float m_separation = 0.0f;
    float m_flat_deviation = 0.0f;
};

// Checks with gtest expectations that `stereo`, the frame the library made of the program's
// `native` frame, holds two eyes (eye 0 on the even columns) that are each the native frame
// moved sideways inside `prediction` and nothing else (no black eye, nothing missing).
FrameDepth ExpectStereoFrame(const ovo_frames::RgbaFrame& native, const ovo_frames::RgbaFrame& stereo,
                             SceneKind scene, const DisparityPrediction& prediction);

// Over the frames of one run: depth above noise where the scene has depth, none where it
// is flat. An animation may start where nothing can be measured, so the run decides.
void ExpectSceneDepth(SceneKind scene, const FrameDepth& deepest);

#endif
