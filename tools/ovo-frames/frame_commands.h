#ifndef OVO_TOOLS_OVO_FRAMES_FRAME_COMMANDS_H
#define OVO_TOOLS_OVO_FRAMES_FRAME_COMMANDS_H

#include "command_line.h"

// The commands that make and compare frames; each returns the tool's exit status.
namespace ovo_frames_tool {

int RunInterleave(const Arguments& arguments);
int RunPreview(const Arguments& arguments);
int RunAnaglyph(const Arguments& arguments);
int RunCompare(const Arguments& arguments);

}  // namespace ovo_frames_tool

#endif
