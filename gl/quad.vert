// Draws a quad over the whole target; v_texCoord is (0, 0) at the bottom left and (1, 1) at the top right.
attribute vec4 vertex;
attribute vec2 texCoord;
varying vec2 v_texCoord;

void main() {
    gl_Position = vertex;
    v_texCoord = texCoord;
}
