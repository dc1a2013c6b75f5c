package com.zor.android.visualeffect.tidemark;

/** The minimal standard generator of the C++ library, so that rain falls in the same places as there. */
final class RainChance {
    private static final long MODULUS = 2147483647;
    private long state;

    RainChance(int seed) {
        state = (seed & 0xffffffffL) % MODULUS;
        if (state == 0) state = 1;
    }

    /** 0 to 1, both included. */
    float draw() {
        state = state * 48271 % MODULUS;
        return (float) ((double) (state - 1) / (MODULUS - 2));
    }
}
