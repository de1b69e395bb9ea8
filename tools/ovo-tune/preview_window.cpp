#include "preview_window.h"

#include <SDL.h>
#include <SDL_syswm.h>
#include <SDL_ttf.h>

#include <algorithm>

namespace ovo_tune {

namespace {

constexpr int WINDOW_FONT_POINTS = 14;
// Room for the text under the image: values, depth, warnings, status, keys.
constexpr int WINDOW_TEXT_LINES = 6;
constexpr int WINDOW_MARGIN = 8;
// A small frame is shown at a whole multiple of its size up to this, a large one shrunk
// into it.
constexpr int WINDOW_IMAGE_MAX_WIDTH = 1280;
constexpr int WINDOW_IMAGE_MAX_HEIGHT = 600;
constexpr int WINDOW_IMAGE_PREFERRED_WIDTH = 640;
constexpr SDL_Color WINDOW_TEXT_COLOUR = {230, 230, 230, 255};
constexpr SDL_Color WINDOW_ALERT_COLOUR = {255, 150, 60, 255};
constexpr uint8_t WINDOW_BACKGROUND_GREY = 24;
// Wide enough for the longest line of text.
constexpr int WINDOW_START_WIDTH = 880;
constexpr int WINDOW_START_HEIGHT = 480;

struct KeyBinding {
    SDL_Keycode m_key;
    ActionKind m_kind;
    EyeParameter m_parameter;
    int m_direction;
    PreviewView m_view;
};

const KeyBinding KEY_BINDINGS[] = {
    {SDLK_UP, ACTION_STEP, EYE_DISTANCE, 1, VIEW_ANAGLYPH},
    {SDLK_DOWN, ACTION_STEP, EYE_DISTANCE, -1, VIEW_ANAGLYPH},
    {SDLK_RIGHT, ACTION_STEP, EYE_ANGLE, 1, VIEW_ANAGLYPH},
    {SDLK_LEFT, ACTION_STEP, EYE_ANGLE, -1, VIEW_ANAGLYPH},
    {SDLK_PAGEUP, ACTION_STEP, EYE_SHIFT, 1, VIEW_ANAGLYPH},
    {SDLK_PAGEDOWN, ACTION_STEP, EYE_SHIFT, -1, VIEW_ANAGLYPH},
    {SDLK_TAB, ACTION_NEXT_VIEW, EYE_DISTANCE, 0, VIEW_ANAGLYPH},
    {SDLK_1, ACTION_VIEW, EYE_DISTANCE, 0, VIEW_ANAGLYPH},
    {SDLK_2, ACTION_VIEW, EYE_DISTANCE, 0, VIEW_SIDE_BY_SIDE},
    {SDLK_3, ACTION_VIEW, EYE_DISTANCE, 0, VIEW_RAW},
    {SDLK_s, ACTION_SAVE, EYE_DISTANCE, 0, VIEW_ANAGLYPH},
    {SDLK_q, ACTION_QUIT, EYE_DISTANCE, 0, VIEW_ANAGLYPH},
    {SDLK_ESCAPE, ACTION_QUIT, EYE_DISTANCE, 0, VIEW_ANAGLYPH},
};

// The image's size in the window: a whole multiple of a small one, a large one shrunk.
void ShownSize(int32_t width, int32_t height, int* shown_width, int* shown_height) {
    double scale = std::min(static_cast<double>(WINDOW_IMAGE_MAX_WIDTH) / width,
                            static_cast<double>(WINDOW_IMAGE_MAX_HEIGHT) / height);
    if (scale >= 1.0) {
        scale = std::max(1.0, std::min(scale, static_cast<double>(WINDOW_IMAGE_PREFERRED_WIDTH) / width));
        scale = static_cast<int>(scale);
    }
    *shown_width = std::max(1, static_cast<int>(width * scale));
    *shown_height = std::max(1, static_cast<int>(height * scale));
}

}  // namespace

const char WINDOW_KEY_HELP[] =
    "Up/Down distance  Right/Left angle  PgUp/PgDn shift  Shift: fine  Tab/1/2/3 view  S save  Q quit";

PreviewWindow::~PreviewWindow() {
    if (m_image != nullptr) SDL_DestroyTexture(m_image);
    if (m_font != nullptr) TTF_CloseFont(m_font);
    if (m_renderer != nullptr) SDL_DestroyRenderer(m_renderer);
    if (m_window != nullptr) SDL_DestroyWindow(m_window);
    if (m_ttf_started) TTF_Quit();
    if (m_sdl_started) SDL_Quit();
}

bool PreviewWindow::Open(const std::string& title, const std::string& font_path, std::string* problem) {
    // Drawn in software: the window must not reach for the GL libraries that ovo-tune's
    // programs get a stand-in for.
    SDL_SetHint(SDL_HINT_RENDER_DRIVER, "software");
    SDL_SetHint(SDL_HINT_RENDER_SCALE_QUALITY, "nearest");
    m_sdl_started = SDL_Init(SDL_INIT_VIDEO) == 0;
    if (!m_sdl_started) {
        *problem = std::string("cannot open the preview window: ") + SDL_GetError();
        return false;
    }
    m_ttf_started = TTF_Init() == 0;
    m_font = m_ttf_started ? TTF_OpenFont(font_path.c_str(), WINDOW_FONT_POINTS) : nullptr;
    if (m_font == nullptr) {
        *problem = "cannot open the font " + font_path + ": " + TTF_GetError();
        return false;
    }
    m_window = SDL_CreateWindow(title.c_str(), SDL_WINDOWPOS_UNDEFINED, SDL_WINDOWPOS_UNDEFINED, WINDOW_START_WIDTH,
                                WINDOW_START_HEIGHT, SDL_WINDOW_RESIZABLE);
    m_renderer = m_window != nullptr ? SDL_CreateRenderer(m_window, -1, SDL_RENDERER_SOFTWARE) : nullptr;
    if (m_renderer == nullptr) {
        *problem = std::string("cannot open the preview window: ") + SDL_GetError();
        return false;
    }
    return true;
}

unsigned long PreviewWindow::NativeId() const {
    SDL_SysWMinfo info;
    SDL_VERSION(&info.version);
    if (m_window == nullptr || !SDL_GetWindowWMInfo(m_window, &info) || info.subsystem != SDL_SYSWM_X11) return 0;
    return static_cast<unsigned long>(info.info.x11.window);
}

void PreviewWindow::TakeActions(std::vector<TuneAction>* actions, bool* closed) {
    SDL_Event event;
    while (SDL_PollEvent(&event) != 0) {
        if (event.type == SDL_QUIT) *closed = true;
        if (event.type != SDL_KEYDOWN) continue;
        for (const KeyBinding& binding : KEY_BINDINGS) {
            if (binding.m_key != event.key.keysym.sym) continue;
            TuneAction action;
            action.m_kind = binding.m_kind;
            action.m_parameter = binding.m_parameter;
            action.m_direction = binding.m_direction;
            action.m_fine = (event.key.keysym.mod & KMOD_SHIFT) != 0;
            action.m_view = binding.m_view;
            actions->push_back(action);
        }
    }
}

void PreviewWindow::FitTo(int32_t width, int32_t height) {
    int shown_width = 0;
    int shown_height = 0;
    ShownSize(width, height, &shown_width, &shown_height);
    const int text_height = WINDOW_TEXT_LINES * TTF_FontLineSkip(m_font) + 2 * WINDOW_MARGIN;
    SDL_SetWindowSize(m_window, std::max(shown_width, WINDOW_START_WIDTH), shown_height + text_height);
}

void PreviewWindow::DrawLine(const WindowLine& line, int y) {
    if (line.m_text.empty()) return;
    SDL_Surface* surface =
        TTF_RenderUTF8_Blended(m_font, line.m_text.c_str(), line.m_alert ? WINDOW_ALERT_COLOUR : WINDOW_TEXT_COLOUR);
    if (surface == nullptr) return;
    SDL_Texture* texture = SDL_CreateTextureFromSurface(m_renderer, surface);
    if (texture != nullptr) {
        const SDL_Rect place = {WINDOW_MARGIN, y, surface->w, surface->h};
        SDL_RenderCopy(m_renderer, texture, nullptr, &place);
        SDL_DestroyTexture(texture);
    }
    SDL_FreeSurface(surface);
}

void PreviewWindow::Show(const ovo_frames::RgbaFrame& image, const std::vector<WindowLine>& lines) {
    if (m_renderer == nullptr) return;
    if (image.m_width > 0 && (image.m_width != m_image_width || image.m_height != m_image_height)) {
        if (m_image != nullptr) SDL_DestroyTexture(m_image);
        m_image = SDL_CreateTexture(m_renderer, SDL_PIXELFORMAT_RGBA32, SDL_TEXTUREACCESS_STREAMING, image.m_width,
                                    image.m_height);
        m_image_width = image.m_width;
        m_image_height = image.m_height;
        FitTo(image.m_width, image.m_height);
    }
    int window_width = 0;
    int window_height = 0;
    SDL_GetRendererOutputSize(m_renderer, &window_width, &window_height);
    SDL_SetRenderDrawColor(m_renderer, WINDOW_BACKGROUND_GREY, WINDOW_BACKGROUND_GREY, WINDOW_BACKGROUND_GREY, 255);
    SDL_RenderClear(m_renderer);

    const int line_skip = TTF_FontLineSkip(m_font);
    const int text_top = window_height - WINDOW_TEXT_LINES * line_skip - WINDOW_MARGIN;
    if (m_image != nullptr && image.m_width > 0) {
        SDL_UpdateTexture(m_image, nullptr, image.m_pixels.data(), image.m_width * 4);
        // The largest place of the image's shape above the text.
        const int room_height = std::max(1, text_top - WINDOW_MARGIN);
        const double scale = std::min(static_cast<double>(window_width) / image.m_width,
                                      static_cast<double>(room_height) / image.m_height);
        const int width = static_cast<int>(image.m_width * scale);
        const int height = static_cast<int>(image.m_height * scale);
        const SDL_Rect place = {(window_width - width) / 2, 0, width, height};
        SDL_RenderCopy(m_renderer, m_image, nullptr, &place);
    }
    for (size_t index = 0; index < lines.size(); ++index) {
        DrawLine(lines[index], text_top + static_cast<int>(index) * line_skip);
    }
    SDL_RenderPresent(m_renderer);
}

}  // namespace ovo_tune
