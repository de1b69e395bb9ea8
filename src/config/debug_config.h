#ifndef OVO_CONFIG_DEBUG_CONFIG_H
#define OVO_CONFIG_DEBUG_CONFIG_H

#include <cstdint>

#include "config/debug_log.h"
#include "config/xml_node.h"

namespace ovo {

// The developer's switch for the diagnostic log.
constexpr const char DEBUG_CONFIG_PATH[] = "/sdcard/duoscope/dconfig.xml";

// Codes of the configuration's keywords; 0 for a name that is not one.
enum DebugKeywordCode : int32_t {
    DEBUG_KEYWORD_NONE = 0,
    DEBUG_KEYWORD_DUOSCOPE = 0x1000,
    DEBUG_KEYWORD_DEBUG = 0x1001,
    DEBUG_KEYWORD_OUTPUT = 0x1002,
    DEBUG_KEYWORD_VERSION = 0x3000,
    DEBUG_KEYWORD_ENABLE = 0x3001,
    DEBUG_KEYWORD_FILENAME = 0x3002,
};

constexpr int32_t DEBUG_KEYWORD_CAPACITY = 128;
constexpr size_t DEBUG_KEYWORD_NAME_CAPACITY = 128;

struct DebugKeyword {
    char m_name[DEBUG_KEYWORD_NAME_CAPACITY];
    int32_t m_code;
};

// Reads "/sdcard/duoscope/dconfig.xml" once and chooses the log writer: a file when the
// configuration switches debugging on, otherwise the silent writer.
class DebugConfig {
public:
    // Never fails; anything wrong with the configuration leaves the log silent.
    DebugConfig();
    // Closes the log file.
    ~DebugConfig();
    DebugConfig(const DebugConfig&) = delete;
    DebugConfig& operator=(const DebugConfig&) = delete;

    // printf-style; written to the log as is, without a newline.
    void Print(const char* format, ...) __attribute__((format(printf, 2, 3)));

    // The code of the first keyword called `name`, or DEBUG_KEYWORD_NONE.
    int32_t LookUpKeyword(const char* name) const;

    int32_t m_count;
    DebugKeyword m_keywords[DEBUG_KEYWORD_CAPACITY];
    DebugLog* m_log;

private:
    void AddKeyword(const char* name, DebugKeywordCode code);
    // Whether the configuration at the device path switches the file log on; if so
    // `filename` receives the log file's device path.
    bool ReadConfiguration(XmlQueryResult* filename) const;
};

}  // namespace ovo

#endif
