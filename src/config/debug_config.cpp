#include "config/debug_config.h"

#include <cstring>

#include "config/xml_reader.h"
#include "platform/device_path.h"

namespace ovo {

DebugConfig::DebugConfig() : m_count(0), m_keywords(), m_log(nullptr) {
    AddKeyword("duoscope", DEBUG_KEYWORD_DUOSCOPE);
    AddKeyword("debug", DEBUG_KEYWORD_DEBUG);
    AddKeyword("output", DEBUG_KEYWORD_OUTPUT);
    AddKeyword("version", DEBUG_KEYWORD_VERSION);
    AddKeyword("enable", DEBUG_KEYWORD_ENABLE);
    AddKeyword("filename", DEBUG_KEYWORD_FILENAME);

    XmlQueryResult filename;
    if (ReadConfiguration(&filename)) m_log = new FileDebugLog(filename.m_text);
    if (m_log == nullptr) m_log = new DebugLog();
}

DebugConfig::~DebugConfig() { delete m_log; }

void DebugConfig::Print(const char* format, ...) {
    va_list arguments;
    va_start(arguments, format);
    m_log->VPrint0(format, arguments);
    va_end(arguments);
}

int32_t DebugConfig::LookUpKeyword(const char* name) const {
    if (name == nullptr) return DEBUG_KEYWORD_NONE;
    for (int32_t i = 0; i < m_count; ++i) {
        if (std::strcmp(m_keywords[i].m_name, name) == 0) return m_keywords[i].m_code;
    }
    return DEBUG_KEYWORD_NONE;
}

void DebugConfig::AddKeyword(const char* name, DebugKeywordCode code) {
    if (m_count >= DEBUG_KEYWORD_CAPACITY) return;
    DebugKeyword& keyword = m_keywords[m_count++];
    std::strncpy(keyword.m_name, name, DEBUG_KEYWORD_NAME_CAPACITY - 1);
    keyword.m_code = code;
}

bool DebugConfig::ReadConfiguration(XmlQueryResult* filename) const {
    char path[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(DEBUG_CONFIG_PATH, path, sizeof(path))) return false;
    XmlElement* document = ParseXmlFile(path);
    if (document == nullptr) return false;

    bool enabled = false;
    const XmlElement* root = document->GetChild(0);
    bool valid = root != nullptr && LookUpKeyword(root->GetName()) == DEBUG_KEYWORD_DUOSCOPE;
    bool versioned = false;
    for (int32_t i = 0; valid && !versioned && i < root->AttributeCount(); ++i) {
        const XmlAttribute* attribute = root->GetAttribute(i);
        versioned = LookUpKeyword(attribute->GetName()) == DEBUG_KEYWORD_VERSION &&
                    attribute->GetValue() != nullptr && std::strcmp(attribute->GetValue(), "1.0") == 0;
    }
    if (versioned && std::strcmp(document->Query("duoscope::debug:$enable").m_text, "true") == 0) {
        *filename = document->Query("duoscope::debug::output:$filename");
        enabled = true;
    }
    delete document;
    return enabled;
}

}  // namespace ovo
