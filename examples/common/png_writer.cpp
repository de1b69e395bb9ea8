#include "common/png_writer.h"

#include <cstdio>

namespace ovo_sample {

namespace {

constexpr uint8_t PNG_SIGNATURE[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
constexpr uint8_t PNG_BIT_DEPTH = 8;
constexpr uint8_t PNG_COLOR_RGB = 2;
constexpr uint8_t PNG_FILTER_NONE = 0;
constexpr size_t DEFLATE_STORED_MAX = 65535;
constexpr uint32_t ADLER_MODULUS = 65521;

uint32_t Crc32(const uint8_t* data, size_t size, uint32_t crc) {
    crc = ~crc;
    for (size_t i = 0; i < size; ++i) {
        crc ^= data[i];
        for (int32_t bit = 0; bit < 8; ++bit) crc = (crc >> 1) ^ (0xEDB88320u & (0u - (crc & 1u)));
    }
    return ~crc;
}

uint32_t Adler32(const std::vector<uint8_t>& data) {
    uint32_t a = 1;
    uint32_t b = 0;
    for (uint8_t byte : data) {
        a = (a + byte) % ADLER_MODULUS;
        b = (b + a) % ADLER_MODULUS;
    }
    return (b << 16) | a;
}

void PutBigEndian32(std::vector<uint8_t>* out, uint32_t value) {
    out->push_back(static_cast<uint8_t>(value >> 24));
    out->push_back(static_cast<uint8_t>(value >> 16));
    out->push_back(static_cast<uint8_t>(value >> 8));
    out->push_back(static_cast<uint8_t>(value));
}

void PutChunk(std::vector<uint8_t>* out, const char type[4], const std::vector<uint8_t>& data) {
    PutBigEndian32(out, static_cast<uint32_t>(data.size()));
    const size_t type_start = out->size();
    out->insert(out->end(), type, type + 4);
    out->insert(out->end(), data.begin(), data.end());
    // The CRC covers the type and the data, not the length.
    PutBigEndian32(out, Crc32(out->data() + type_start, 4 + data.size(), 0));
}

// A zlib stream of stored deflate blocks.
std::vector<uint8_t> StoreZlib(const std::vector<uint8_t>& raw) {
    std::vector<uint8_t> out = {0x78, 0x01};
    size_t offset = 0;
    do {
        const size_t size = raw.size() - offset < DEFLATE_STORED_MAX ? raw.size() - offset
                                                                     : DEFLATE_STORED_MAX;
        const bool last = offset + size == raw.size();
        out.push_back(last ? 1 : 0);
        out.push_back(static_cast<uint8_t>(size));
        out.push_back(static_cast<uint8_t>(size >> 8));
        out.push_back(static_cast<uint8_t>(~size));
        out.push_back(static_cast<uint8_t>(~size >> 8));
        out.insert(out.end(), raw.begin() + offset, raw.begin() + offset + size);
        offset += size;
    } while (offset < raw.size());
    PutBigEndian32(&out, Adler32(raw));
    return out;
}

}  // namespace

std::vector<uint8_t> EncodePng(int32_t width, int32_t height, const uint8_t* rgba) {
    const size_t pixel_count = static_cast<size_t>(width) * static_cast<size_t>(height);
    std::vector<uint8_t> raw;
    raw.reserve(pixel_count * 3 + static_cast<size_t>(height));
    for (size_t i = 0; i < pixel_count; ++i) {
        if (i % static_cast<size_t>(width) == 0) raw.push_back(PNG_FILTER_NONE);
        raw.insert(raw.end(), rgba + i * 4, rgba + i * 4 + 3);
    }

    std::vector<uint8_t> header;
    PutBigEndian32(&header, static_cast<uint32_t>(width));
    PutBigEndian32(&header, static_cast<uint32_t>(height));
    header.push_back(PNG_BIT_DEPTH);
    header.push_back(PNG_COLOR_RGB);
    header.push_back(0);  // compression: deflate
    header.push_back(0);  // filter method: adaptive
    header.push_back(0);  // no interlace

    std::vector<uint8_t> png(PNG_SIGNATURE, PNG_SIGNATURE + sizeof(PNG_SIGNATURE));
    PutChunk(&png, "IHDR", header);
    PutChunk(&png, "IDAT", StoreZlib(raw));
    PutChunk(&png, "IEND", {});
    return png;
}

bool WritePng(const char* path, int32_t width, int32_t height, const uint8_t* rgba) {
    const std::vector<uint8_t> png = EncodePng(width, height, rgba);
    FILE* file = std::fopen(path, "wb");
    if (file == nullptr) return false;
    const bool written = std::fwrite(png.data(), 1, png.size(), file) == png.size();
    return std::fclose(file) == 0 && written;
}

}  // namespace ovo_sample
