#include "config/debug_log.h"

#include <cstdint>

#include "platform/device_path.h"
#include "platform/log.h"
#include "platform/regular_file.h"

namespace ovo {

namespace {

FILE* OpenLogFile(const char* device_path) {
    char path[DEVICE_PATH_CAPACITY];
    path[0] = '\0';
    bool mapped = device_path != nullptr && MakeDevicePath(device_path, path, sizeof(path));
    FILE* file = mapped ? OpenRegularStream(path, REGULAR_FILE_REPLACE) : nullptr;
    // Only the low 32 bits of the stream pointer on 64-bit builds: it merely tells
    // success from failure in the log. The line names the mode that a text log is
    // written with, whichever call opened it.
    LogPrint(LOG_PRIORITY_INFO, "stream(0x%08x) = fopen(path=%s, attrib=%s)\n",
             static_cast<unsigned>(reinterpret_cast<uintptr_t>(file)), path, "wt");
    return file;
}

}  // namespace

DebugLog::~DebugLog() = default;
void DebugLog::Reserved0() {}
void DebugLog::Reserved1() {}
void DebugLog::VPrint0(const char*, va_list) {}
void DebugLog::VPrint1(const char*, va_list) {}
void DebugLog::VPrint2(const char*, va_list) {}
void DebugLog::VPrint3(const char*, va_list) {}
void DebugLog::VPrintTagged(const char*, const char*, va_list) {}
void DebugLog::Write(const char*) {}

FileDebugLog::FileDebugLog(const char* path) : m_file(OpenLogFile(path)) {
    if (m_file == nullptr) m_file = OpenLogFile(DEBUG_LOG_FALLBACK_PATH);
}

FileDebugLog::~FileDebugLog() {
    if (m_file != nullptr) std::fclose(m_file);
}

void FileDebugLog::VWrite(const char* format, va_list arguments) {
    if (m_file != nullptr) std::vfprintf(m_file, format, arguments);
}

void FileDebugLog::VPrint0(const char* format, va_list arguments) { VWrite(format, arguments); }
void FileDebugLog::VPrint1(const char* format, va_list arguments) { VWrite(format, arguments); }
void FileDebugLog::VPrint2(const char* format, va_list arguments) { VWrite(format, arguments); }
void FileDebugLog::VPrint3(const char* format, va_list arguments) { VWrite(format, arguments); }

void FileDebugLog::VPrintTagged(const char* prefix, const char* format, va_list arguments) {
    if (m_file == nullptr) return;
    std::fputs(prefix, m_file);
    std::vfprintf(m_file, format, arguments);
}

void FileDebugLog::Write(const char* text) {
    if (m_file != nullptr) std::fputs(text, m_file);
}

}  // namespace ovo
