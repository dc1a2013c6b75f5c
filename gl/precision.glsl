precision mediump float;
// What needs more than the 11 bits of half precision, where the device has it: positions, and ink in two bytes.
#ifdef GL_FRAGMENT_PRECISION_HIGH
#define FULL highp
#else
#define FULL mediump
#endif
