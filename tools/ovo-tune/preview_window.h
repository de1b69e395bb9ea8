#ifndef OVO_TOOLS_OVO_TUNE_PREVIEW_WINDOW_H
#define OVO_TOOLS_OVO_TUNE_PREVIEW_WINDOW_H

#include <string>
#include <vector>

#include "rgba_frame.h"
#include "tune_action.h"

struct SDL_Renderer;
struct SDL_Texture;
struct SDL_Window;
typedef struct _TTF_Font TTF_Font;

// The preview window (SDL2, text through SDL_ttf): the view of the newest frame above a
// few lines of text, and the keys that tune.
//   Up / Down          eye distance up / down a step
//   Right / Left       eye angle
//   Page Up / Down     eye shift
//   Shift with these   a fine step (a tenth)
//   Tab, 1, 2, 3       the next view; anaglyph, side by side, raw
//   S                  save the profile
//   Q, Escape          quit (the window's close button too)
namespace ovo_tune {

// The keys, as the window's last line shows them.
extern const char WINDOW_KEY_HELP[];

struct WindowLine {
    std::string m_text;
    bool m_alert = false;  // drawn in the warning colour
};

class PreviewWindow {
public:
    PreviewWindow() = default;
    ~PreviewWindow();
    PreviewWindow(const PreviewWindow&) = delete;
    PreviewWindow& operator=(const PreviewWindow&) = delete;

    // False, with the reason, when there is no display or the font cannot be opened.
    bool Open(const std::string& title, const std::string& font_path, std::string* problem);
    // The X11 window's id (for a screenshot or a key sender), 0 on another video driver.
    unsigned long NativeId() const;

    // The keys pressed since the last call; `closed` is set when the window was closed.
    void TakeActions(std::vector<TuneAction>* actions, bool* closed);
    // Shows `image` (nothing while it is empty) above `lines`. The window takes the image's
    // size, within limits, whenever that size changes.
    void Show(const ovo_frames::RgbaFrame& image, const std::vector<WindowLine>& lines);

private:
    void FitTo(int32_t width, int32_t height);
    void DrawLine(const WindowLine& line, int y);

    SDL_Window* m_window = nullptr;
    SDL_Renderer* m_renderer = nullptr;
    SDL_Texture* m_image = nullptr;
    TTF_Font* m_font = nullptr;
    int32_t m_image_width = 0;
    int32_t m_image_height = 0;
    bool m_sdl_started = false;
    bool m_ttf_started = false;
};

}  // namespace ovo_tune

#endif
