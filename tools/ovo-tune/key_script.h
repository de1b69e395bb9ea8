#ifndef OVO_TOOLS_OVO_TUNE_KEY_SCRIPT_H
#define OVO_TOOLS_OVO_TUNE_KEY_SCRIPT_H

#include <string>

// The words of a key script as they become available: all of a --keys text at once, or
// from a file or standard input as it is written, so that another program can drive
// ovo-tune key by key. Words are separated by white space; '#' starts a comment that runs
// to the line's end.
namespace ovo_tune {

class KeyScript {
public:
    KeyScript() = default;
    ~KeyScript();
    KeyScript(const KeyScript&) = delete;
    KeyScript& operator=(const KeyScript&) = delete;

    void SetText(const std::string& text);
    // `path` "-" is standard input. False, with the reason naming the file, when it cannot
    // be opened.
    bool OpenFile(const std::string& path, std::string* problem);

    // The next whole word when one has arrived; never waits.
    bool NextWord(std::string* word);
    // No word is left and none will come.
    bool Finished();

private:
    void ReadAvailable();

    int m_descriptor = -1;
    bool m_owns_descriptor = false;
    std::string m_pending;
};

}  // namespace ovo_tune

#endif
