#include "tune_action.h"

namespace ovo_tune {

namespace {

constexpr char FINE_PREFIX = 'f';

// The letter of each parameter in key scripts, by EyeParameter.
constexpr char PARAMETER_LETTERS[EYE_PARAMETER_COUNT] = {'d', 'a', 's'};

struct NamedAction {
    const char* m_word;
    ActionKind m_kind;
};

const NamedAction NAMED_ACTIONS[] = {
    {"view", ACTION_NEXT_VIEW},
    {"save", ACTION_SAVE},
    {"quit", ACTION_QUIT},
};

// "d+", "fa-": a parameter's step.
bool ParseStep(const std::string& word, TuneAction* action) {
    const bool fine = word.size() == 3 && word[0] == FINE_PREFIX;
    if (word.size() != (fine ? 3u : 2u)) return false;
    const char letter = word[fine ? 1 : 0];
    const char sign = word.back();
    if (sign != '+' && sign != '-') return false;
    for (int index = 0; index < EYE_PARAMETER_COUNT; ++index) {
        if (letter != PARAMETER_LETTERS[index]) continue;
        action->m_kind = ACTION_STEP;
        action->m_parameter = static_cast<EyeParameter>(index);
        action->m_direction = sign == '+' ? 1 : -1;
        action->m_fine = fine;
        return true;
    }
    return false;
}

}  // namespace

bool ParseActionWord(const std::string& word, TuneAction* action, std::string* problem) {
    *action = TuneAction();
    if (ParseStep(word, action)) return true;
    for (const NamedAction& named : NAMED_ACTIONS) {
        if (word != named.m_word) continue;
        action->m_kind = named.m_kind;
        return true;
    }
    for (int view = 0; view < PREVIEW_VIEW_COUNT; ++view) {
        if (word != ViewWord(static_cast<PreviewView>(view))) continue;
        action->m_kind = ACTION_VIEW;
        action->m_view = static_cast<PreviewView>(view);
        return true;
    }
    *problem = "unknown key '" + word + "' (expected d+ d- a+ a- s+ s-, fd+ ... for a fine step, view, anaglyph, " +
               "sbs, raw, save or quit)";
    return false;
}

std::string ActionWord(const TuneAction& action) {
    switch (action.m_kind) {
        case ACTION_STEP: {
            std::string word = action.m_fine ? std::string(1, FINE_PREFIX) : std::string();
            word += PARAMETER_LETTERS[action.m_parameter];
            return word + (action.m_direction > 0 ? '+' : '-');
        }
        case ACTION_VIEW: return ViewWord(action.m_view);
        default: break;
    }
    for (const NamedAction& named : NAMED_ACTIONS) {
        if (named.m_kind == action.m_kind) return named.m_word;
    }
    return "";
}

}  // namespace ovo_tune
