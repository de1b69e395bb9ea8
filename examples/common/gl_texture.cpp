#include "common/gl_texture.h"

#include <GLES2/gl2.h>

// Only calls that OpenGL ES 1.1 and 2.0 share, so both kinds of sample link this.
namespace ovo_sample {

uint32_t CreateTexture(const RgbaImage& image, const TextureSampling& sampling) {
    GLuint texture = 0;
    glGenTextures(1, &texture);
    glBindTexture(GL_TEXTURE_2D, texture);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, sampling.m_min_filter);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, sampling.m_mag_filter);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, sampling.m_wrap_s);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, sampling.m_wrap_t);
    glPixelStorei(GL_UNPACK_ALIGNMENT, 4);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, image.m_width, image.m_height, 0, GL_RGBA,
                 GL_UNSIGNED_BYTE, image.m_pixels.data());
    return texture;
}

void DeleteTexture(uint32_t* texture) {
    if (*texture == 0) return;
    const GLuint name = *texture;
    glDeleteTextures(1, &name);
    *texture = 0;
}

void ReplaceTexture(uint32_t* texture, uint32_t replacement) {
    if (*texture == replacement) return;
    DeleteTexture(texture);
    *texture = replacement;
}

}  // namespace ovo_sample
