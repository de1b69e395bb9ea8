#ifndef OVO_STEREO_SHADER_SOURCE_STORE_H
#define OVO_STEREO_SHADER_SOURCE_STORE_H

#include <cstdint>
#include <mutex>
#include <string>
#include <unordered_map>

#include "core/gl_api.h"

namespace ovo {

// The sources that applications set for the vertex shaders whose text the library
// rewrote: the vendor compiles the rewritten text, while the application reads back its
// own source, as it set it. Shaders are named per share group, so the group is part of
// the key. Guarded by a lock: a loading thread may set sources while another deletes.
class ShaderSourceStore {
public:
    // The application's source of `shader`, as the vendor read its strings back, and the
    // GL_SHADER_SOURCE_LENGTH the vendor gave for it; replaces what was kept before.
    void Keep(uint32_t group, GLuint shader, const char* source, GLint source_length);
    void Forget(uint32_t group, GLuint shader);
    // Everything of a share group whose last context went.
    void ForgetGroup(uint32_t group);

    // GL_SHADER_SOURCE_LENGTH of a kept source; false when none is kept.
    bool SourceLength(uint32_t group, GLuint shader, GLint* length) const;
    // glGetShaderSource of a kept source, under the vendor's rules for the buffer; false
    // when none is kept. `buffer_size` must not be negative.
    bool CopySource(uint32_t group, GLuint shader, GLsizei buffer_size, GLsizei* length,
                    GLchar* source) const;

    size_t Count() const;

private:
    struct KeptSource {
        std::string m_text;
        GLint m_source_length;
    };
    static uint64_t Key(uint32_t group, GLuint shader) {
        return (static_cast<uint64_t>(group) << 32) | shader;
    }

    mutable std::mutex m_lock;
    std::unordered_map<uint64_t, KeptSource> m_sources;
};

}  // namespace ovo

#endif
