#include <GLES/gl.h>
#include <GLES2/gl2.h>

#include "threads_together.h"

void ContextlessCaller::Run() {
    static const GLfloat TRIANGLE[] = {-1, -1, -2, 1, -1, -2, 0, 1, -2};
    static const GLubyte PIXEL[] = {255, 0, 0, 255};
    while (!m_stop.load()) {
        GLuint texture = 0;
        glGenTextures(1, &texture);
        glBindTexture(GL_TEXTURE_2D, 7);
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, 1, 1, 0, GL_RGBA, GL_UNSIGNED_BYTE, PIXEL);
        glBindFramebuffer(GL_FRAMEBUFFER, 3);
        glViewport(0, 0, 1, 1);
        glScissor(0, 0, 1, 1);
        glClear(GL_COLOR_BUFFER_BIT | GL_STENCIL_BUFFER_BIT);
        glEnableClientState(GL_VERTEX_ARRAY);
        glVertexPointer(3, GL_FLOAT, 0, TRIANGLE);
        glDrawArrays(GL_TRIANGLES, 0, 3);
        GLint viewport[4] = {0, 0, 0, 0};
        glGetIntegerv(GL_VIEWPORT, viewport);
        m_answers += texture + glGetError() + viewport[2] + (glGetString(GL_VERSION) != nullptr);
        m_rounds.fetch_add(1);
    }
}
