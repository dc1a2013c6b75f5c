// A quad over the whole target; v_texCoord runs from 0 at the left and bottom edges to 1 at the right and top.
attribute vec4 vertex;
attribute vec2 texCoord;
varying vec2 v_texCoord;

void main() {
    gl_Position = vertex;
    v_texCoord = texCoord;
}
