#include "common/png_writer.h"

#include <png.h>
#include <unistd.h>

#include <csetjmp>
#include <cstdio>
#include <string>

namespace ovo_sample {

namespace {

// Fixed rather than left to the library's default, so the bytes stay the same across
// libpng versions that might change it.
constexpr int PNG_COMPRESSION_LEVEL = 6;
constexpr size_t PNG_RGBA_BYTES = 4;

// libpng reports failures by longjmp, so nothing here may need destroying.
bool EncodeTo(FILE* file, int32_t width, int32_t height, const uint8_t* rgba) {
    png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
    if (png == nullptr) return false;
    png_infop info = png_create_info_struct(png);
    if (info == nullptr) {
        png_destroy_write_struct(&png, nullptr);
        return false;
    }
    if (setjmp(png_jmpbuf(png)) != 0) {
        png_destroy_write_struct(&png, &info);
        return false;
    }
    png_init_io(png, file);
    png_set_IHDR(png, info, static_cast<png_uint_32>(width), static_cast<png_uint_32>(height), 8,
                 PNG_COLOR_TYPE_RGB, PNG_INTERLACE_NONE, PNG_COMPRESSION_TYPE_DEFAULT,
                 PNG_FILTER_TYPE_DEFAULT);
    png_set_compression_level(png, PNG_COMPRESSION_LEVEL);
    png_write_info(png, info);
    // The rows hold RGBA; the fourth byte of each pixel is dropped on the way out.
    png_set_filler(png, 0, PNG_FILLER_AFTER);
    const size_t row_bytes = static_cast<size_t>(width) * PNG_RGBA_BYTES;
    for (int32_t row = 0; row < height; ++row) {
        png_write_row(png, rgba + row_bytes * static_cast<size_t>(row));
    }
    png_write_end(png, nullptr);
    png_destroy_write_struct(&png, &info);
    return true;
}

}  // namespace

bool WritePng(const char* path, int32_t width, int32_t height, const uint8_t* rgba) {
    const std::string temporary = std::string(path) + "." + std::to_string(getpid()) + ".tmp";
    FILE* file = std::fopen(temporary.c_str(), "wb");
    if (file == nullptr) return false;
    const bool encoded = EncodeTo(file, width, height, rgba);
    const bool closed = std::fclose(file) == 0;
    if (encoded && closed && std::rename(temporary.c_str(), path) == 0) return true;
    std::remove(temporary.c_str());
    return false;
}

}  // namespace ovo_sample
