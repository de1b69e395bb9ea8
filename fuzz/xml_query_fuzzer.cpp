// The first line of the input is a query path, the rest a configuration file. A query
// must stay within its result and can only ever return (the start of) an attribute value.
#include "xml_fuzz_support.h"

namespace {

using ovo::FuzzCheck;

bool HoldsValue(const ovo::XmlElement* element, const char* text) {
    for (int32_t i = 0; i < element->AttributeCount(); ++i) {
        const char* value = element->GetAttribute(i)->GetValue();
        if (value != nullptr && std::strncmp(value, text, ovo::XML_QUERY_RESULT_CAPACITY - 1) == 0) {
            return true;
        }
    }
    for (int32_t i = 0; i < element->ChildCount(); ++i) {
        if (HoldsValue(element->GetChild(i), text)) return true;
    }
    return false;
}

void CheckQuery(ovo::XmlElement* document, ovo::XmlElement* start, const char* path) {
    ovo::XmlQueryResult result = start->Query(path);
    size_t length = strnlen(result.m_text, sizeof(result.m_text));
    FuzzCheck(length < sizeof(result.m_text));
    FuzzCheck(length == 0 || HoldsValue(document, result.m_text));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const uint8_t* end_of_path =
        size == 0 ? nullptr : static_cast<const uint8_t*>(std::memchr(data, '\n', size));
    size_t path_length = end_of_path == nullptr ? size : static_cast<size_t>(end_of_path - data);
    char* path = static_cast<char*>(std::malloc(path_length + 1));
    FuzzCheck(path != nullptr);
    if (path_length > 0) std::memcpy(path, data, path_length);
    path[path_length] = '\0';

    size_t xml_offset = end_of_path == nullptr ? size : path_length + 1;
    ovo::XmlElement* document = ovo::ParseXmlBytes(data + xml_offset, size - xml_offset);
    if (document != nullptr) {
        CheckQuery(document, document, path);
        for (int32_t i = 0; i < document->ChildCount(); ++i) {
            CheckQuery(document, document->GetChild(i), path);
        }
        delete document;
    }
    std::free(path);
    return 0;
}
