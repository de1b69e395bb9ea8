#ifndef OVO_TOOLS_OVO_TUNE_TUNE_ACTION_H
#define OVO_TOOLS_OVO_TUNE_TUNE_ACTION_H

#include <string>

#include "eye_values.h"
#include "preview_view.h"

// What a key does, whether it was pressed in the preview window or named in a key script.
namespace ovo_tune {

enum ActionKind {
    ACTION_STEP,       // one parameter up or down a step
    ACTION_NEXT_VIEW,  // anaglyph, side by side, raw, round again
    ACTION_VIEW,       // one view
    ACTION_SAVE,       // the profile text with the tuned values, written back
    ACTION_QUIT,
};

struct TuneAction {
    ActionKind m_kind = ACTION_QUIT;
    EyeParameter m_parameter = EYE_DISTANCE;
    int m_direction = 0;  // +1 or -1
    bool m_fine = false;
    PreviewView m_view = VIEW_ANAGLYPH;
};

// A key script's word: d+ d- a+ a- s+ s- (eye distance, eye angle, eye shift up or down a
// step), the same with an f before them for a fine step (fd+), view (the next view),
// anaglyph, sbs, raw, save, quit. False, with the reason in `problem`, for another word.
bool ParseActionWord(const std::string& word, TuneAction* action, std::string* problem);

// The script word of an action ("fd+", "save"), for the tool's report of each key.
std::string ActionWord(const TuneAction& action);

}  // namespace ovo_tune

#endif
