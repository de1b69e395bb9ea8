#ifndef OVO_TOOLS_OVO_TUNE_EYE_VALUES_H
#define OVO_TOOLS_OVO_TUNE_EYE_VALUES_H

#include <string>

// The live stereo parameters that ovo-tune changes, and the steps it changes them by.
namespace ovo_tune {

enum EyeParameter {
    EYE_DISTANCE = 0,
    EYE_ANGLE = 1,
    EYE_SHIFT = 2,
};
constexpr int EYE_PARAMETER_COUNT = 3;

// What the live-tuning file carries: the three eye parameters and the ramp steps, which
// ovo-tune leaves at the profile's value (the library sets them from the file too).
struct EyeValues {
    double m_parameters[EYE_PARAMETER_COUNT] = {0.0, 0.0, 0.0};
    double m_ramp_steps = 0.0;
};

// A key's change of each parameter; a fine step is a tenth of it.
struct EyeSteps {
    double m_coarse[EYE_PARAMETER_COUNT] = {0.0, 0.0, 0.0};
};
constexpr double FINE_STEP_FRACTION = 0.1;

// A tenth of each of the profile's values, so that the steps suit the game's scale (an
// eye distance of 0.02 in one game, 200 in another); for a value of 0 (or one whose tenth
// rounds to 0 in six decimals) 0.005, 0.005 and 0.001.
EyeSteps DefaultSteps(const EyeValues& profile_values);

// The parameter moved up (direction +1) or down (-1) by its coarse or fine step, then
// rounded to the six decimals of the live-tuning file, so that what ovo-tune shows, what
// the library reads and what is saved are the same number.
void Step(EyeValues& values, const EyeSteps& steps, EyeParameter parameter, int direction, bool fine);

// `value` rounded to six decimals, as "%f" writes it.
double RoundToFileDecimals(double value);

// The live-tuning file's text: eye distance, eye angle, eye shift, ramp steps and an
// unused fifth number, as "%f %f %f %f %f" with a line end.
std::string LiveTuningText(const EyeValues& values);

// The parameter's name in the profile's text form ("eye_distance", ...).
const char* ParameterName(EyeParameter parameter);

}  // namespace ovo_tune

#endif
