#include "config/xml_reader.h"

#include <cstring>

#include "config/xml_tokenizer.h"
#include "platform/regular_file.h"

namespace ovo {

namespace {

bool ReadAttribute(XmlTokenizer& tokenizer, XmlElement* element) {
    XmlAttribute* attribute = new XmlAttribute();
    attribute->SetName(tokenizer.Text());
    if (!element->AppendAttribute(attribute)) {
        delete attribute;
        return false;
    }
    if (tokenizer.Next() != XML_TOKEN_EQUALS || tokenizer.Next() != XML_TOKEN_STRING) return false;
    attribute->SetValue(tokenizer.Text());
    return true;
}

// Reads the rest of an element whose "<" has been read. Null when it fails; a failed
// element takes everything attached to it along.
XmlElement* ReadElement(XmlTokenizer& tokenizer, int depth);

// False when the element fails.
bool ReadElementBody(XmlTokenizer& tokenizer, XmlElement* element, int depth) {
    if (depth > XML_DEPTH_LIMIT || tokenizer.Next() != XML_TOKEN_NAME) return false;
    element->SetName(tokenizer.Text());

    bool in_start_tag = true;
    for (;;) {
        switch (tokenizer.Next()) {
            case XML_TOKEN_NAME:
                if (in_start_tag && !ReadAttribute(tokenizer, element)) return false;
                break;
            case XML_TOKEN_TAG_END:
                in_start_tag = false;
                if (tokenizer.ReadText() > 0) element->SetValue(tokenizer.Text());
                break;
            case XML_TOKEN_TAG_OPEN: {
                XmlElement* child = ReadElement(tokenizer, depth + 1);
                if (child == nullptr) return false;
                if (!element->AppendChild(child)) {
                    delete child;
                    return false;
                }
                break;
            }
            case XML_TOKEN_EMPTY_TAG_END:
                return true;
            case XML_TOKEN_CLOSE_TAG_OPEN:
                return element->GetName() != nullptr && tokenizer.Next() == XML_TOKEN_NAME &&
                       std::strcmp(tokenizer.Text(), element->GetName()) == 0 &&
                       tokenizer.Next() == XML_TOKEN_TAG_END;
            case XML_TOKEN_EOF:
                return true;  // kept as far as it was read
            case XML_TOKEN_ERROR:
                return false;
            default:
                break;
        }
    }
}

XmlElement* ReadElement(XmlTokenizer& tokenizer, int depth) {
    XmlElement* element = new XmlElement();
    if (!ReadElementBody(tokenizer, element, depth)) {
        delete element;
        return nullptr;
    }
    return element;
}

}  // namespace

XmlElement* ParseXmlFile(const char* path) {
    FILE* stream = OpenRegularStream(path, REGULAR_FILE_READ);
    if (stream == nullptr) return nullptr;
    XmlElement* document = ParseXmlStream(stream);
    std::fclose(stream);
    return document;
}

// The tokenizer lives on this call's stack rather than in static storage, so parses
// on different threads cannot disturb each other.
XmlElement* ParseXmlStream(FILE* stream) {
    XmlTokenizer tokenizer(stream);
    XmlElement* document = new XmlElement();
    bool in_instruction = false;
    for (XmlToken token = tokenizer.Next(); token != XML_TOKEN_EOF; token = tokenizer.Next()) {
        if (in_instruction) {
            // Inside "<?" ... "?>" every token is ignored, a token error included.
            in_instruction = token != XML_TOKEN_PI_CLOSE;
        } else if (token == XML_TOKEN_PI_OPEN) {
            in_instruction = true;
        } else if (token == XML_TOKEN_TAG_OPEN) {
            // A failed top-level element is dropped and reading goes on after it.
            XmlElement* element = ReadElement(tokenizer, 1);
            if (element != nullptr && !document->AppendChild(element)) delete element;
        } else if (token == XML_TOKEN_ERROR) {
            delete document;
            return nullptr;
        }
    }
    return document;
}

}  // namespace ovo
