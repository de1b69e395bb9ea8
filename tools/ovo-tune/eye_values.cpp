#include "eye_values.h"

#include <cmath>
#include <cstdio>

namespace ovo_tune {

namespace {

// Steps for a parameter that the profile leaves at 0: eye distance and angle move the
// depth of OpenGL ES 2.0 games by about a pixel per step on an 800-pixel panel, the shift
// of flat draws is finer.
constexpr double ZERO_VALUE_STEPS[EYE_PARAMETER_COUNT] = {0.005, 0.005, 0.001};
constexpr double DEFAULT_STEP_FRACTION = 0.1;
constexpr double FILE_DECIMALS_SCALE = 1e6;

const char* const PARAMETER_NAMES[EYE_PARAMETER_COUNT] = {"eye_distance", "eye_angle", "eye_shift"};

}  // namespace

EyeSteps DefaultSteps(const EyeValues& profile_values) {
    EyeSteps steps;
    for (int index = 0; index < EYE_PARAMETER_COUNT; ++index) {
        const double scaled =
            RoundToFileDecimals(std::fabs(profile_values.m_parameters[index]) * DEFAULT_STEP_FRACTION);
        steps.m_coarse[index] = std::isfinite(scaled) && scaled > 0.0 ? scaled : ZERO_VALUE_STEPS[index];
    }
    return steps;
}

double RoundToFileDecimals(double value) { return std::round(value * FILE_DECIMALS_SCALE) / FILE_DECIMALS_SCALE; }

void Step(EyeValues& values, const EyeSteps& steps, EyeParameter parameter, int direction, bool fine) {
    const double step = steps.m_coarse[parameter] * (fine ? FINE_STEP_FRACTION : 1.0);
    double& value = values.m_parameters[parameter];
    value = RoundToFileDecimals(value + direction * step);
    if (value == 0.0) value = 0.0;  // no "-0.000000"
}

std::string LiveTuningText(const EyeValues& values) {
    char text[2048];  // five numbers of up to 316 characters each, as "%f" writes 1e308
    std::snprintf(text, sizeof(text), "%f %f %f %f %f\n", values.m_parameters[EYE_DISTANCE],
                  values.m_parameters[EYE_ANGLE], values.m_parameters[EYE_SHIFT], values.m_ramp_steps, 0.0);
    return text;
}

const char* ParameterName(EyeParameter parameter) { return PARAMETER_NAMES[parameter]; }

}  // namespace ovo_tune
