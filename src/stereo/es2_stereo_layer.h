#ifndef OVO_STEREO_ES2_STEREO_LAYER_H
#define OVO_STEREO_ES2_STEREO_LAYER_H

#include <cstdint>

#include "stereo/drawing_layer.h"

namespace ovo {

// How Es2StereoLayer treats the application's framebuffers.
constexpr uint32_t LAYER_SUBMODE_TRACKED = 0x1000;  // render textures at double width
constexpr uint32_t LAYER_SUBMODE_DIRECT = 0x1001;   // draws into them once, unchanged

// The OpenGL ES 2.0 stereo layer: every vertex shader gains the depth-shift uniform (while
// the application reads back the source it set), and every draw into the window is
// issued once per eye with the eye's value of it. In the
// tracked submode render textures are made double width and drawn per eye, each eye into
// its own half, and each eye later samples its own half.
class Es2StereoLayer : public DrawingLayer {
public:
    explicit Es2StereoLayer(uint32_t submode) : m_submode(submode) {}

    // The submode for a process of this name.
    static uint32_t SubmodeFor(const char* process_name);

    void glBindFramebuffer(StereoManager& manager, GLenum target, GLuint framebuffer) override;
    void glBindTexture(StereoManager& manager, GLenum target, GLuint texture) override;
    void glClear(StereoManager& manager, GLbitfield mask) override;
    void glDeleteShader(StereoManager& manager, GLuint shader) override;
    void glDeleteTextures(StereoManager& manager, GLsizei n, const GLuint* textures) override;
    void glFramebufferTexture2D(StereoManager& manager, GLenum target, GLenum attachment,
                                GLenum textarget, GLuint texture, GLint level) override;
    void glGetShaderSource(StereoManager& manager, GLuint shader, GLsizei bufSize,
                           GLsizei* length, GLchar* source) override;
    void glGetShaderiv(StereoManager& manager, GLuint shader, GLenum pname,
                       GLint* params) override;
    void glRenderbufferStorage(StereoManager& manager, GLenum target, GLenum internalformat,
                               GLsizei width, GLsizei height) override;
    void glShaderSource(StereoManager& manager, GLuint shader, GLsizei count,
                        const GLchar* const* string, const GLint* length) override;
    void glTexImage2D(StereoManager& manager, GLenum target, GLint level, GLint internalformat,
                      GLsizei width, GLsizei height, GLint border, GLenum format, GLenum type,
                      const void* pixels) override;

    uint32_t Submode() const { return m_submode; }

protected:
    void Draw(StereoManager& manager, const DrawCall& draw) override;

private:
    bool Tracked() const { return m_submode == LAYER_SUBMODE_TRACKED; }

    uint32_t m_submode;
};

}  // namespace ovo

#endif
