#include "png_reader.h"

#include <png.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <vector>

namespace ovo_frames {

namespace {

// Far beyond any panel, small enough that a forged header cannot ask for gigabytes.
constexpr uint64_t FRAME_MAX_PIXELS = uint64_t{1} << 26;
constexpr size_t PNG_SIGNATURE_BYTES = 8;
// What libpng's reader from memory says when the data runs out.
constexpr char PNG_MESSAGE_END_OF_DATA[] = "read beyond end of data";

bool ReadWholeFile(const char* path, std::vector<uint8_t>* bytes, std::string* problem) {
    FILE* file = std::fopen(path, "rb");
    if (file == nullptr) {
        *problem = std::strerror(errno);
        return false;
    }
    uint8_t buffer[65536];
    size_t got;
    while ((got = std::fread(buffer, 1, sizeof(buffer), file)) > 0) bytes->insert(bytes->end(), buffer, buffer + got);
    const bool failed = std::ferror(file) != 0;
    if (failed) *problem = std::strerror(errno);
    std::fclose(file);
    return !failed;
}

std::string Explain(const png_image& image) {
    if (std::strcmp(image.message, PNG_MESSAGE_END_OF_DATA) == 0) return "truncated: the file ends inside the image";
    return image.message;
}

}  // namespace

bool ReadPng(const char* path, RgbaFrame* frame, std::string* problem) {
    std::vector<uint8_t> bytes;
    if (!ReadWholeFile(path, &bytes, problem)) return false;
    if (bytes.size() < PNG_SIGNATURE_BYTES || png_sig_cmp(bytes.data(), 0, PNG_SIGNATURE_BYTES) != 0) {
        *problem = "not a PNG file";
        return false;
    }
    // The simplified API keeps libpng's longjmp inside libpng.
    png_image image;
    std::memset(&image, 0, sizeof(image));
    image.version = PNG_IMAGE_VERSION;
    if (png_image_begin_read_from_memory(&image, bytes.data(), bytes.size()) == 0) {
        *problem = Explain(image);
        return false;
    }
    if (uint64_t{image.width} * image.height > FRAME_MAX_PIXELS) {
        png_image_free(&image);
        *problem = "image of " + std::to_string(image.width) + "x" + std::to_string(image.height) +
                   " pixels is too large";
        return false;
    }
    image.format = PNG_FORMAT_RGBA;
    *frame = RgbaFrame(static_cast<int32_t>(image.width), static_cast<int32_t>(image.height));
    if (png_image_finish_read(&image, nullptr, frame->m_pixels.data(), 0, nullptr) == 0) {
        *problem = Explain(image);
        return false;
    }
    return true;
}

}  // namespace ovo_frames
