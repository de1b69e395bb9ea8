#version 100
/* Two-bone skinning; vertices with a single full weight skip the blend. */
precision mediump float;

uniform mat4 u_mvp;
uniform mat4 u_bones[24];

attribute vec4 a_position;
attribute vec2 a_bone_indices;
attribute vec2 a_bone_weights;
attribute vec2 a_uv;

varying vec2 v_uv;

void main()
{
    v_uv = a_uv;
    mat4 first = u_bones[int(a_bone_indices.x)];
    if (a_bone_weights.x >= 0.999)
    {
        gl_Position = u_mvp * (first * a_position);
        return;
    }
    mat4 second = u_bones[int(a_bone_indices.y)];
    vec4 blended = a_bone_weights.x * (first * a_position) + a_bone_weights.y * (second * a_position);
    gl_Position = u_mvp * blended;
}
