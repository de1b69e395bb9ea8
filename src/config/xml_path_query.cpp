#include "config/xml_node.h"

namespace ovo {

namespace {

// Copies the segment that starts at `path` into `segment` and returns where the next one
// starts, or null at the end of the path. A segment too long for `segment` is
// rejected rather than cut: a shortened name could match another element.
const char* NextSegment(const char* path, char (&segment)[XML_QUERY_SEGMENT_CAPACITY],
                        bool* fits) {
    size_t length = 0;
    *fits = true;
    while (*path != '\0') {
        if (path[0] == ':' && (path[1] == ':' || path[1] == '$')) {
            segment[length] = '\0';
            return path + 2;
        }
        if (length + 1 < XML_QUERY_SEGMENT_CAPACITY) {
            segment[length++] = *path;
        } else {
            *fits = false;
        }
        ++path;
    }
    segment[length] = '\0';
    return nullptr;
}

}  // namespace

XmlQueryResult XmlElement::Query(const char* path) {
    XmlQueryResult result;
    result.m_text[0] = '\0';
    if (path == nullptr) return result;

    XmlElement* node = this;
    char segment[XML_QUERY_SEGMENT_CAPACITY];
    bool fits = true;
    const char* rest = NextSegment(path, segment, &fits);
    while (rest != nullptr) {
        node = fits ? node->FindElement(segment) : nullptr;
        if (node == nullptr) return result;
        rest = NextSegment(rest, segment, &fits);
    }
    const XmlAttribute* attribute = fits ? node->FindAttribute(segment) : nullptr;
    if (attribute == nullptr || attribute->GetValue() == nullptr) return result;

    // Longer values are cut to the result's 255 characters.
    std::strncpy(result.m_text, attribute->GetValue(), XML_QUERY_RESULT_CAPACITY - 1);
    result.m_text[XML_QUERY_RESULT_CAPACITY - 1] = '\0';
    return result;
}

}  // namespace ovo
