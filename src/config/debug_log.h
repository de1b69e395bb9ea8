#ifndef OVO_CONFIG_DEBUG_LOG_H
#define OVO_CONFIG_DEBUG_LOG_H

#include <cstdarg>
#include <cstdio>

namespace ovo {

// The fallback when the configured log file cannot be opened.
constexpr const char DEBUG_LOG_FALLBACK_PATH[] = "/data/duoscope/debug.log";

// The diagnostic log writer. This base class is the silent writer: every write does
// nothing. Writers add nothing to the text: no time stamp, no newline.
class DebugLog {
public:
    DebugLog() = default;
    virtual ~DebugLog();
    DebugLog(const DebugLog&) = delete;
    DebugLog& operator=(const DebugLog&) = delete;

    virtual void Reserved0();
    virtual void Reserved1();
    virtual void VPrint0(const char* format, va_list arguments);
    virtual void VPrint1(const char* format, va_list arguments);
    virtual void VPrint2(const char* format, va_list arguments);
    virtual void VPrint3(const char* format, va_list arguments);
    virtual void VPrintTagged(const char* prefix, const char* format, va_list arguments);
    virtual void Write(const char* text);
};

// Writes into a file, opened (and truncated) when the writer is built.
class FileDebugLog : public DebugLog {
public:
    // `path` is a device path; when it cannot be opened (or is not a regular file) the
    // fallback is tried, and when that fails too the writer stays silent.
    explicit FileDebugLog(const char* path);
    ~FileDebugLog() override;

    void VPrint0(const char* format, va_list arguments) override;
    void VPrint1(const char* format, va_list arguments) override;
    void VPrint2(const char* format, va_list arguments) override;
    void VPrint3(const char* format, va_list arguments) override;
    void VPrintTagged(const char* prefix, const char* format, va_list arguments) override;
    void Write(const char* text) override;

private:
    void VWrite(const char* format, va_list arguments);

    FILE* m_file;
};

}  // namespace ovo

#endif
