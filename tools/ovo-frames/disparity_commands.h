#ifndef OVO_TOOLS_OVO_FRAMES_DISPARITY_COMMANDS_H
#define OVO_TOOLS_OVO_FRAMES_DISPARITY_COMMANDS_H

#include "command_line.h"

// The commands that measure the depth of a stereo frame; each returns the tool's exit
// status and prints its figures as "name = value" lines.
namespace ovo_frames_tool {

int RunDisparity(const Arguments& arguments);
int RunMatchEyes(const Arguments& arguments);

}  // namespace ovo_frames_tool

#endif
