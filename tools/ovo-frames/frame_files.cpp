#include "frame_files.h"

#include <cstring>

#include "common/png_writer.h"
#include "png_reader.h"

namespace ovo_frames_tool {

using ovo_frames::RgbaFrame;

std::string SizeText(const RgbaFrame& frame) {
    return std::to_string(frame.m_width) + "x" + std::to_string(frame.m_height);
}

bool Load(const char* path, RgbaFrame* frame) {
    std::string problem;
    if (ovo_frames::ReadPng(path, frame, &problem)) return true;
    Fail(path, problem);
    return false;
}

bool LoadRaw(const char* path, RgbaFrame* raw) {
    if (!Load(path, raw)) return false;
    if (raw->m_width % 2 == 0) return true;
    Fail(path, "width " + std::to_string(raw->m_width) + " is odd; the eyes' columns come in pairs");
    return false;
}

bool LoadSameSize(const char* path, const RgbaFrame& like, const char* like_path, RgbaFrame* frame) {
    if (!Load(path, frame)) return false;
    if (frame->m_width == like.m_width && frame->m_height == like.m_height) return true;
    Fail(path, SizeText(*frame) + ", but " + like_path + " is " + SizeText(like));
    return false;
}

int Save(const char* path, const RgbaFrame& frame) {
    if (ovo_sample::WritePng(path, frame.m_width, frame.m_height, frame.m_pixels.data())) return 0;
    return Fail(path, "cannot write");
}

ovo_frames::ColumnParity Eye0Columns(const Arguments& arguments) {
    return std::strcmp(arguments.m_eye0_columns, "odd") == 0 ? ovo_frames::COLUMN_PARITY_ODD
                                                             : ovo_frames::COLUMN_PARITY_EVEN;
}

}  // namespace ovo_frames_tool
