#ifndef OVO_FUZZ_XML_FUZZ_SUPPORT_H
#define OVO_FUZZ_XML_FUZZ_SUPPORT_H

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "config/xml_reader.h"

namespace ovo {

// Stops the run where the fault is, so the fuzzer keeps the input.
inline void FuzzCheck(bool condition) {
    if (!condition) std::abort();
}

// Parses `size` bytes as a configuration file would be parsed.
inline XmlElement* ParseXmlBytes(const uint8_t* data, size_t size) {
    static char empty[1];
    void* bytes = size == 0 ? static_cast<void*>(empty) : const_cast<uint8_t*>(data);
    FILE* stream = fmemopen(bytes, size, "r");
    FuzzCheck(stream != nullptr);
    XmlElement* document = ParseXmlStream(stream);
    std::fclose(stream);
    return document;
}

}  // namespace ovo

#endif
