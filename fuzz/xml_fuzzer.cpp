// Any bytes as the debug configuration file: the reader must neither crash nor build a
// tree that breaks its own limits.
#include "config/xml_tokenizer.h"
#include "xml_fuzz_support.h"

namespace {

using ovo::FuzzCheck;

// Every name and value came out of the 1024-byte token buffer.
void CheckText(const char* text) {
    FuzzCheck(text == nullptr || std::strlen(text) < ovo::XML_TOKEN_CAPACITY);
}

void CheckElement(const ovo::XmlElement* element, int depth) {
    FuzzCheck(depth <= ovo::XML_DEPTH_LIMIT);
    FuzzCheck(depth == 0 || element->GetName() != nullptr);
    CheckText(element->GetName());
    CheckText(element->GetValue());
    for (int32_t i = 0; i < element->AttributeCount(); ++i) {
        const ovo::XmlAttribute* attribute = element->GetAttribute(i);
        FuzzCheck(attribute != nullptr && attribute->GetName() != nullptr);
        CheckText(attribute->GetName());
        CheckText(attribute->GetValue());
    }
    FuzzCheck(element->GetAttribute(element->AttributeCount()) == nullptr);
    for (int32_t i = 0; i < element->ChildCount(); ++i) {
        const ovo::XmlElement* child = element->GetChild(i);
        FuzzCheck(child != nullptr);
        CheckElement(child, depth + 1);
    }
    FuzzCheck(element->GetChild(element->ChildCount()) == nullptr && element->GetChild(-1) == nullptr);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    ovo::XmlElement* document = ovo::ParseXmlBytes(data, size);
    if (document != nullptr) {
        FuzzCheck(document->GetName() == nullptr);
        CheckElement(document, 0);
        delete document;
    }
    return 0;
}
