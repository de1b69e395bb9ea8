#ifndef OVO_PRESENT_LIVE_TUNING_TEXT_H
#define OVO_PRESENT_LIVE_TUNING_TEXT_H

#include <cstddef>

namespace ovo {

// Numbers that the live-tuning file holds: eye distance, eye angle, eye shift, ramp steps
// and one unused.
constexpr int LIVE_TUNING_VALUES = 5;

// The live-tuning file is read up to this many bytes, however long it is. Five numbers fit
// with room to spare: a float's exact value, or the point halfway between two neighbouring
// floats that decides a rounding, written out in full takes at most 153 characters (a
// sign, "0." and 150 decimals for the smallest; 39 digits for the largest), which leaves
// more than 3,300 bytes for the white space before the five. A longer digit string moves
// a float only where it sits on such a halfway point for all 150 decimals and goes on past
// it; nobody writes those. Past the bound nothing is read: a number that does not end
// within these bytes (with the character that ends it) counts as missing, as in a file
// that ended before it, so it and every position after it read 0.
constexpr size_t LIVE_TUNING_READ_LIMIT = 4096;

// Converts the numbers at the start of `text` as fscanf with "%f %f %f %f %f" converts them
// from a file of the same bytes, character for character as the GNU C library reads "%f"
// (so "1e" reads 1, "0x" nothing, "nan(1)" a NaN followed by text that is no number), and
// each number's text through strtof. The point is '.', as in the C locale.
// `text` holds `size` bytes and room for one more, which is borrowed and put back. When
// `whole` is false the bytes are only the start of a longer file: a number, or the white
// space before one, that reaches their end could go on past it, so it counts as missing.
// Returns how many values were converted; the positions after them are left as they were.
int ScanLiveTuningText(char* text, size_t size, bool whole, float (&values)[LIVE_TUNING_VALUES]);

}  // namespace ovo

#endif
