#ifndef OVO_CONFIG_XML_NODE_H
#define OVO_CONFIG_XML_NODE_H

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace ovo {

// Room that a list makes at its first append; it doubles whenever it is full.
constexpr int32_t XML_LIST_FIRST_CAPACITY = 16;
// Room for a query result: 255 characters and the terminator.
constexpr size_t XML_QUERY_RESULT_CAPACITY = 256;
// Room for one segment of a query path: 63 characters and the terminator.
constexpr size_t XML_QUERY_SEGMENT_CAPACITY = 64;

// A name and a value, each an owned copy on the C heap; either may be null.
class XmlNode {
public:
    XmlNode() : m_name(nullptr), m_value(nullptr) {}
    virtual ~XmlNode();
    XmlNode(const XmlNode&) = delete;
    XmlNode& operator=(const XmlNode&) = delete;

    const char* GetName() const { return m_name; }
    const char* GetValue() const { return m_value; }
    // Store a copy of `text`; null clears.
    void SetName(const char* text);
    void SetValue(const char* text);

private:
    char* m_name;
    char* m_value;
};

class XmlAttribute : public XmlNode {};

class XmlElement;

// A growable array of owned node pointers.
template <typename Node>
class XmlNodeList {
public:
    XmlNodeList() : m_items(nullptr), m_capacity(0), m_count(0) {}
    ~XmlNodeList() {
        for (int32_t i = 0; i < m_count; ++i) delete m_items[i];
        std::free(m_items);
    }
    XmlNodeList(const XmlNodeList&) = delete;
    XmlNodeList& operator=(const XmlNodeList&) = delete;

    // Takes ownership of `node` on success; false only when no memory is left.
    bool Append(Node* node) {
        if (m_count >= m_capacity && !Grow()) return false;
        m_items[m_count++] = node;
        return true;
    }
    Node* Get(int32_t index) const {
        return index < 0 || index >= m_count ? nullptr : m_items[index];
    }
    int32_t Count() const { return m_count; }

private:
    // Doubling rather than a fixed step: n appends then copy fewer than n entries in all,
    // where a fixed step copied about n * n / (2 * step) of them.
    bool Grow() {
        if (m_capacity > INT32_MAX / 2) return false;
        const int32_t capacity = m_capacity == 0 ? XML_LIST_FIRST_CAPACITY : 2 * m_capacity;
        if (static_cast<size_t>(capacity) > SIZE_MAX / sizeof(Node*)) return false;
        Node** items = static_cast<Node**>(std::realloc(m_items, sizeof(Node*) * capacity));
        if (items == nullptr) return false;
        m_items = items;
        m_capacity = capacity;
        return true;
    }

    Node** m_items;
    int32_t m_capacity;
    int32_t m_count;
};

using XmlElementList = XmlNodeList<XmlElement>;
using XmlAttributeList = XmlNodeList<XmlAttribute>;

// The text that a query found; empty when it found nothing.
struct XmlQueryResult {
    char m_text[XML_QUERY_RESULT_CAPACITY];
};

// An element: its name, its text content as the value, its children and attributes.
// A document is an element without a name whose children are the top-level elements.
class XmlElement : public XmlNode {
public:
    XmlElement() = default;
    ~XmlElement() override;

    XmlElement* GetChild(int32_t index) const { return m_children.Get(index); }
    XmlAttribute* GetAttribute(int32_t index) const { return m_attributes.Get(index); }
    int32_t ChildCount() const { return m_children.Count(); }
    int32_t AttributeCount() const { return m_attributes.Count(); }
    bool AppendChild(XmlElement* child) { return m_children.Append(child); }
    bool AppendAttribute(XmlAttribute* attribute) { return m_attributes.Append(attribute); }

    // This element when its own name is `name`, else its first child of that name.
    XmlElement* FindElement(const char* name);
    XmlAttribute* FindAttribute(const char* name) const;

    // The value of the attribute that `path` names, e.g. "duoscope::debug:$enable":
    // element names separated by "::" or ":$", the last segment an attribute name.
    XmlQueryResult Query(const char* path);

private:
    XmlElementList m_children;
    XmlAttributeList m_attributes;
};

}  // namespace ovo

#endif
