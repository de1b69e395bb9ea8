#include "config/version_report.h"

#include <cstdio>

#include "platform/device_path.h"
#include "platform/regular_file.h"

#ifndef OVO_BUILD_REVISION
#define OVO_BUILD_REVISION "unknown"
#endif

namespace ovo {

VersionReport::VersionReport(const char* report_path)
    : path(nullptr), package_name(nullptr), is_es2(0), m_path_buffer{} {
    if (report_path == nullptr) {
        if (MakeDevicePath(VERSION_REPORT_PATH, m_path_buffer, sizeof(m_path_buffer))) {
            path = m_path_buffer;
        }
    } else {
        path = report_path;
    }
}

const char* VersionReport::BuildTag() {
    return "(r " OVO_BUILD_REVISION ")(" __DATE__ "," __TIME__ ")";
}

void VersionReport::Write() {
    if (path == nullptr) return;
    FILE* file = OpenRegularStream(path, REGULAR_FILE_REPLACE);
    if (file == nullptr) return;
    std::fprintf(file, "%s\n", BuildTag());
    std::fputs("[package name]\n\t", file);
    std::fprintf(file, "%s\n", package_name != nullptr ? package_name : "");
    std::fputs("[gl version]\n\t", file);
    std::fprintf(file, "%s\n", is_es2 ? "OpenGL ES 2.0" : "OpenGL ES 1.x");
    std::fclose(file);
}

}  // namespace ovo
