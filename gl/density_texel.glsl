// density = 255 R + G: R holds the whole part, G the fraction. Decoding is linear, so a filtered texel decodes to the
// filtered density.
FULL float decodeDensity(FULL vec4 texel) {
    return 255.0 * texel.x + texel.y;
}
