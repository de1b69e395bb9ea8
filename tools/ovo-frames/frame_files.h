#ifndef OVO_TOOLS_OVO_FRAMES_FRAME_FILES_H
#define OVO_TOOLS_OVO_FRAMES_FRAME_FILES_H

#include <string>

#include "column_ops.h"
#include "command_line.h"

// The commands' frames on disk; each failure is said on standard error with the file's name.
namespace ovo_frames_tool {

std::string SizeText(const ovo_frames::RgbaFrame& frame);

bool Load(const char* path, ovo_frames::RgbaFrame* frame);

// An interleaved frame, whose eyes' columns come in pairs: its width must be even.
bool LoadRaw(const char* path, ovo_frames::RgbaFrame* raw);

// Loads `path` and checks that it has the size of `like`, the frame from `like_path`.
bool LoadSameSize(const char* path, const ovo_frames::RgbaFrame& like, const char* like_path,
                  ovo_frames::RgbaFrame* frame);

// Returns 0 when written, else EXIT_TROUBLE.
int Save(const char* path, const ovo_frames::RgbaFrame& frame);

ovo_frames::ColumnParity Eye0Columns(const Arguments& arguments);

}  // namespace ovo_frames_tool

#endif
