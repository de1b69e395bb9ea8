#include "frame_commands.h"

#include <cstdio>

#include "frame_compare.h"
#include "frame_files.h"

namespace ovo_frames_tool {

namespace {

using ovo_frames::RgbaFrame;

constexpr long TOLERANCE_MAX = 255;

std::string PixelText(const RgbaFrame& frame, int32_t x, int32_t y) {
    const uint8_t* pixel = frame.At(x, y);
    char text[32];
    std::snprintf(text, sizeof(text), "(%u, %u, %u, %u)", pixel[0], pixel[1], pixel[2], pixel[3]);
    return text;
}

}  // namespace

// As large as the samples' pbuffers go.
constexpr long FRAME_SIDE_MAX = 8192;

// The mask area of the command line, or null without one; false after a usage error.
bool ReadMaskArea(const Arguments& arguments, ovo_frames::MaskArea* area, const ovo_frames::MaskArea** chosen) {
    *chosen = nullptr;
    if (arguments.m_mask_area == nullptr && arguments.m_outside_eye == nullptr) return true;
    if (arguments.m_mask_area == nullptr || arguments.m_outside_eye == nullptr) {
        UsageError("--mask-area", "goes with --outside-eye");
        return false;
    }
    if (!ParseSize("--mask-area", arguments.m_mask_area, FRAME_SIDE_MAX, &area->m_width, &area->m_height) ||
        !ParseWholeNumber("--outside-eye", arguments.m_outside_eye, 0, 1, &area->m_outside_eye)) {
        return false;
    }
    *chosen = area;
    return true;
}

int RunInterleave(const Arguments& arguments) {
    ovo_frames::MaskArea area = {};
    const ovo_frames::MaskArea* mask_area = nullptr;
    if (!ReadMaskArea(arguments, &area, &mask_area)) return EXIT_TROUBLE;
    RgbaFrame eye0;
    RgbaFrame eye1;
    if (!Load(arguments.m_files[0], &eye0) || !LoadSameSize(arguments.m_files[1], eye0, arguments.m_files[0], &eye1)) {
        return EXIT_TROUBLE;
    }
    return Save(arguments.m_output, ovo_frames::Interleave(eye0, eye1, Eye0Columns(arguments), mask_area));
}

int RunPreview(const Arguments& arguments) {
    RgbaFrame raw;
    if (!LoadRaw(arguments.m_files[0], &raw)) return EXIT_TROUBLE;
    return Save(arguments.m_output, ovo_frames::Preview(raw, Eye0Columns(arguments)));
}

int RunAnaglyph(const Arguments& arguments) {
    RgbaFrame raw;
    if (!LoadRaw(arguments.m_files[0], &raw)) return EXIT_TROUBLE;
    return Save(arguments.m_output, ovo_frames::Anaglyph(raw, Eye0Columns(arguments)));
}

int RunCompare(const Arguments& arguments) {
    const char* name_a = arguments.m_files[0];
    const char* name_b = arguments.m_files[1];
    int32_t tolerance = 0;
    if (!ParseWholeNumber("--tolerance", arguments.m_tolerance, 0, TOLERANCE_MAX, &tolerance)) return EXIT_TROUBLE;
    RgbaFrame a;
    RgbaFrame b;
    if (!Load(name_a, &a) || !Load(name_b, &b)) return EXIT_TROUBLE;
    if (a.m_width != b.m_width || a.m_height != b.m_height) {
        std::printf("%s is %s, %s is %s: the sizes differ\n", name_a, SizeText(a).c_str(), name_b,
                    SizeText(b).c_str());
        return EXIT_NO;
    }
    const ovo_frames::FrameDifference difference = ovo_frames::CompareFrames(a, b, tolerance);
    if (difference.m_differing_pixels == 0) return 0;
    const int32_t x = difference.m_first_x;
    const int32_t y = difference.m_first_y;
    std::printf("%s and %s differ: %lld pixels by more than %d, largest difference %d, first at (%d, %d): %s and %s\n",
                name_a, name_b, static_cast<long long>(difference.m_differing_pixels), tolerance,
                difference.m_largest, x, y, PixelText(a, x, y).c_str(), PixelText(b, x, y).c_str());
    return EXIT_NO;
}

}  // namespace ovo_frames_tool
