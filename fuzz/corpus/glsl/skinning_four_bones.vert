// Four-bone linear blend skinning for character meshes.
#version 100
precision highp float;

const int MAX_BONES = 32;

uniform mat4 u_view_projection;
uniform vec4 u_bones[MAX_BONES * 3];  // rows of 3x4 bone matrices

attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec2 a_uv;
attribute vec4 a_bone_indices;
attribute vec4 a_bone_weights;

varying vec2 v_uv;
varying vec3 v_normal;

vec3 SkinPoint(vec4 p, int bone) {
    return vec3(dot(u_bones[bone * 3], p), dot(u_bones[bone * 3 + 1], p),
                dot(u_bones[bone * 3 + 2], p));
}

vec3 SkinVector(vec3 n, int bone) {
    return vec3(dot(u_bones[bone * 3].xyz, n), dot(u_bones[bone * 3 + 1].xyz, n),
                dot(u_bones[bone * 3 + 2].xyz, n));
}

void main() {
    vec4 position = vec4(a_position, 1.0);
    vec3 skinned = vec3(0.0);
    vec3 normal = vec3(0.0);
    for (int i = 0; i < 4; ++i) {
        int bone = int(a_bone_indices[i]);
        skinned += a_bone_weights[i] * SkinPoint(position, bone);
        normal += a_bone_weights[i] * SkinVector(a_normal, bone);
    }
    v_uv = a_uv;
    v_normal = normalize(normal);
    gl_Position = u_view_projection * vec4(skinned, 1.0);
}
