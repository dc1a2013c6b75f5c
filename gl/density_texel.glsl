// A texel of ink: R holds the whole part, G the fraction. Linear, so that a filtered texel decodes to filtered ink.
FULL float decodeDensity(FULL vec4 texel) {
    return 255.0 * texel.x + texel.y;
}
