#include "disparity_commands.h"

#include <algorithm>
#include <cstdio>
#include <string>

#include "block_match.h"
#include "disparity_map.h"
#include "disparity_summary.h"
#include "eye_compensation.h"
#include "frame_files.h"
#include "screen_disparity.h"

namespace ovo_frames_tool {

namespace {

using ovo_frames::BlockMatchOptions;
using ovo_frames::DisparityRange;
using ovo_frames::RgbaFrame;

constexpr long BLOCK_SIZE_MIN = 2;
constexpr long BLOCK_SIZE_MAX = 1024;
constexpr long MAX_SHIFT_MAX = 1024;
constexpr long BAND_ROWS_MAX = 65536;
constexpr int32_t HISTOGRAM_BAR_MAX = 50;

bool ReadMatchingOptions(const Arguments& arguments, BlockMatchOptions* options) {
    return ParseWholeNumber("--block", arguments.m_block, BLOCK_SIZE_MIN, BLOCK_SIZE_MAX, &options->m_block_size) &&
           ParseWholeNumber("--max-shift", arguments.m_max_shift, 1, MAX_SHIFT_MAX, &options->m_max_shift);
}

void PrintFrame(const RgbaFrame& raw, const BlockMatchOptions& options) {
    std::printf("frame = %dx%d\neye_size = %dx%d\nblock = %d\nmax_shift = %d\n", raw.m_width, raw.m_height,
                raw.m_width / 2, raw.m_height, options.m_block_size, options.m_max_shift);
}

void PrintShift(const char* prefix, const char* name, bool known, float shift) {
    if (known) {
        std::printf("%s%s = %.2f\n", prefix, name, shift);
    } else {
        std::printf("%s%s = unknown\n", prefix, name);
    }
}

// `unit` names the pixels of the shifts, of which the screen is `width` wide.
void PrintRange(const char* prefix, const DisparityRange& range, const char* unit, int32_t width) {
    const bool known = range.m_known_blocks > 0;
    std::printf("%sblocks_known = %d\n%sblocks_unknown = %d\n", prefix, range.m_known_blocks, prefix,
                range.m_unknown_blocks);
    const std::string nearest = std::string("nearest_") + unit;
    const std::string farthest = std::string("farthest_") + unit;
    PrintShift(prefix, nearest.c_str(), known, range.m_nearest);
    PrintShift(prefix, farthest.c_str(), known, range.m_farthest);
    PrintShift(prefix, "nearest_percent", known, ovo_frames::PercentOfWidth(range.m_nearest, width));
    PrintShift(prefix, "farthest_percent", known, ovo_frames::PercentOfWidth(range.m_farthest, width));
}

void PrintComfort(const DisparityRange& range, int32_t eye_width, const ovo_frames::ComfortBudget& budget) {
    std::printf("budget_near_percent = %.2f\nbudget_far_percent = %.2f\n", budget.m_near_percent, budget.m_far_percent);
    const ovo_frames::ComfortVerdict verdict = ovo_frames::CheckComfort(range, eye_width, budget);
    if (verdict.m_too_near) {
        std::printf("warning = nearest %.2f %% of the width is further in front than the budget's %.2f %%\n",
                    ovo_frames::PercentOfWidth(-range.m_nearest, eye_width), budget.m_near_percent);
    }
    if (verdict.m_too_far) {
        std::printf("warning = farthest %.2f %% of the width is further behind than the budget's %.2f %%\n",
                    ovo_frames::PercentOfWidth(range.m_farthest, eye_width), budget.m_far_percent);
    }
}

void PrintHistogram(const ovo_frames::DisparityHistogram& histogram) {
    const auto highest = std::max_element(histogram.m_counts.begin(), histogram.m_counts.end());
    for (size_t bin = 0; bin < histogram.m_counts.size(); ++bin) {
        const int32_t count = histogram.m_counts[bin];
        const int32_t bar = (count * HISTOGRAM_BAR_MAX + *highest - 1) / *highest;
        std::printf("histogram[%+d] = %d%s%s\n", histogram.m_lowest + static_cast<int32_t>(bin), count,
                    bar > 0 ? " " : "", std::string(static_cast<size_t>(bar), '#').c_str());
    }
}

void PrintBands(const std::vector<ovo_frames::ShiftEstimate>& bands, int32_t band_rows, int32_t height) {
    for (size_t band = 0; band < bands.size(); ++band) {
        const int32_t first = static_cast<int32_t>(band) * band_rows;
        char name[48];
        std::snprintf(name, sizeof(name), "band[%d-%d]", first, std::min(first + band_rows, height) - 1);
        PrintShift("", name, bands[band].m_known, bands[band].m_shift);
    }
}

}  // namespace

int RunDisparity(const Arguments& arguments) {
    BlockMatchOptions options;
    ovo_frames::ComfortBudget budget;
    int32_t band_rows = 0;
    if (!ReadMatchingOptions(arguments, &options) ||
        !ParsePercent("--budget-near", arguments.m_budget_near, &budget.m_near_percent) ||
        !ParsePercent("--budget-far", arguments.m_budget_far, &budget.m_far_percent) ||
        !ParseWholeNumber("--bands", arguments.m_bands, 1, BAND_ROWS_MAX, &band_rows)) {
        return EXIT_TROUBLE;
    }
    RgbaFrame raw;
    if (!LoadRaw(arguments.m_files[0], &raw)) return EXIT_TROUBLE;
    const ovo_frames::ColumnParity eye0_columns = Eye0Columns(arguments);
    const ovo_frames::DisparityField field = ovo_frames::MeasureScreenDisparity(raw, eye0_columns, options);
    const DisparityRange range = ovo_frames::MeasureRange(field);
    if (arguments.m_map != nullptr && Save(arguments.m_map, ovo_frames::DisparityMapImage(field, range)) != 0) {
        return EXIT_TROUBLE;
    }
    const int32_t eye_width = field.m_image_width;
    PrintFrame(raw, options);
    PrintRange("", range, "px", eye_width);
    PrintComfort(range, eye_width, budget);
    PrintHistogram(ovo_frames::HistogramOf(field));
    if (band_rows > 0) {
        PrintBands(ovo_frames::MeasureScreenDisparityBands(raw, eye0_columns, band_rows, options), band_rows,
                   raw.m_height);
    }
    if (arguments.m_map != nullptr) std::printf("map = %s\n", arguments.m_map);
    return range.m_known_blocks > 0 ? 0 : EXIT_NO;
}

int RunMatchEyes(const Arguments& arguments) {
    BlockMatchOptions options;
    if (!ReadMatchingOptions(arguments, &options)) return EXIT_TROUBLE;
    const char* raw_path = arguments.m_files[0];
    RgbaFrame raw;
    RgbaFrame native;
    if (!LoadRaw(raw_path, &raw) || !LoadSameSize(arguments.m_files[1], raw, raw_path, &native)) return EXIT_TROUBLE;
    const ovo_frames::ColumnParity eye0_columns = Eye0Columns(arguments);
    const ovo_frames::EyeImages eyes = ovo_frames::Deinterleave(raw, eye0_columns);
    PrintFrame(raw, options);
    // --max-shift is in eye pixels for both commands; the eyes are matched in screen pixels.
    BlockMatchOptions on_screen = options;
    on_screen.m_max_shift = options.m_max_shift * ovo_frames::EYE_PIXEL_SCREEN_COLUMNS;
    const struct {
        const char* m_prefix;
        const RgbaFrame& m_eye;
        ovo_frames::ColumnParity m_columns;
    } pairs[] = {{"eye0.", eyes.m_eye0, eye0_columns}, {"eye1.", eyes.m_eye1, ovo_frames::OtherParity(eye0_columns)}};
    for (const auto& pair : pairs) {
        const ovo_frames::CompensationSummary summary =
            ovo_frames::MeasureCompensation(pair.m_eye, native, pair.m_columns, on_screen);
        PrintRange(pair.m_prefix, ovo_frames::MeasureRange(summary.m_shifts), "screen_px", raw.m_width);
        std::printf("%sunknown_fraction = %.3f\n%sresidual_mean = %.2f\n%sresidual_p95 = %.2f\n%sresidual_worst = %.2f\n",
                    pair.m_prefix, summary.m_unknown_fraction, pair.m_prefix, summary.m_residual_mean, pair.m_prefix,
                    summary.m_residual_high, pair.m_prefix, summary.m_residual_worst);
    }
    return 0;
}

}  // namespace ovo_frames_tool
