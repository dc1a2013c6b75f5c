precision mediump float;
// FULL marks values that need more than the 11 bits of a half float: positions and two-byte densities. It is highp if the
// fragment shader supports it.
#ifdef GL_FRAGMENT_PRECISION_HIGH
#define FULL highp
#else
#define FULL mediump
#endif
