#ifndef OVO_PRESENT_LIVE_TUNING_H
#define OVO_PRESENT_LIVE_TUNING_H

#include <cstddef>

namespace ovo {

class StereoProfile;

// A text file through which the live stereo parameters can be changed while a game runs:
// up to five numbers, eye distance, eye angle, eye shift, ramp steps and one unused.
constexpr const char LIVE_TUNING_PATH[] = "/sdcard/game_profile.txt";

// The file is read up to this many bytes, however long it is. Five numbers fit with room
// to spare: a float written out to every digit that can change it takes at most 153
// characters (a sign, "0." and 150 decimals for the smallest).
constexpr size_t LIVE_TUNING_READ_LIMIT = 4096;

// Reads the file into the profile's live parameters, as fscanf with "%f %f %f %f %f" reads
// the file's first LIVE_TUNING_READ_LIMIT bytes. A missing file changes nothing; a position
// that holds no number sets its parameter to 0.
void ReadLiveTuning(StereoProfile& profile);

}  // namespace ovo

#endif
