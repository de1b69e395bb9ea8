#ifndef OVO_PRESENT_LIVE_TUNING_H
#define OVO_PRESENT_LIVE_TUNING_H

namespace ovo {

class StereoProfile;

// A text file through which the live stereo parameters can be changed while a game runs:
// up to five numbers, eye distance, eye angle, eye shift, ramp steps and one unused.
constexpr const char LIVE_TUNING_PATH[] = "/sdcard/game_profile.txt";

// Reads the file into the profile's live parameters. A missing file changes nothing; a
// position that holds no number sets its parameter to 0. Only the file's first
// LIVE_TUNING_READ_LIMIT bytes are read (live_tuning_text.h).
void ReadLiveTuning(StereoProfile& profile);

}  // namespace ovo

#endif
