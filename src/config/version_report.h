#ifndef OVO_CONFIG_VERSION_REPORT_H
#define OVO_CONFIG_VERSION_REPORT_H

#include <cstdint>

namespace ovo {

constexpr const char VERSION_REPORT_PATH[] = "/sdcard/duoscope/version.txt";

// The small file that tells which build runs in which application and which OpenGL ES
// generation it asked for. Rewritten at every context creation of an enabled process.
class VersionReport {
public:
    // `path` null selects VERSION_REPORT_PATH below the device root.
    explicit VersionReport(const char* path);

    void SetPackageName(const char* name) { package_name = name; }
    void SetGlVersion(int32_t es2) { is_es2 = es2; }
    // Replaces the file; silently does nothing when it cannot be opened or something
    // other than a regular file is at the path.
    void Write();

    // Identifies this build: "(r <revision>)(<date>,<time>)".
    static const char* BuildTag();

private:
    const char* path;
    const char* package_name;
    int32_t is_es2;
    char m_path_buffer[4096];
};

}  // namespace ovo

#endif
