#include "config/xml_node.h"

namespace ovo {

namespace {

// Null when `text` is null or no memory is left.
char* CopyText(const char* text) {
    if (text == nullptr) return nullptr;
    size_t size = std::strlen(text) + 1;
    char* copy = static_cast<char*>(std::malloc(size));
    if (copy != nullptr) std::memcpy(copy, text, size);
    return copy;
}

bool SameName(const XmlNode& node, const char* name) {
    return node.GetName() != nullptr && name != nullptr && std::strcmp(node.GetName(), name) == 0;
}

}  // namespace

XmlNode::~XmlNode() {
    std::free(m_name);
    std::free(m_value);
}

// Copied before the old text is freed, so that a node's own text can be passed back in.
void XmlNode::SetName(const char* text) {
    char* copy = CopyText(text);
    std::free(m_name);
    m_name = copy;
}

void XmlNode::SetValue(const char* text) {
    char* copy = CopyText(text);
    std::free(m_value);
    m_value = copy;
}

XmlElement::~XmlElement() = default;

XmlElement* XmlElement::FindElement(const char* name) {
    if (SameName(*this, name)) return this;
    for (int32_t i = 0; i < m_children.Count(); ++i) {
        if (SameName(*m_children.Get(i), name)) return m_children.Get(i);
    }
    return nullptr;
}

XmlAttribute* XmlElement::FindAttribute(const char* name) const {
    for (int32_t i = 0; i < m_attributes.Count(); ++i) {
        if (SameName(*m_attributes.Get(i), name)) return m_attributes.Get(i);
    }
    return nullptr;
}

}  // namespace ovo
