package com.zor.android.visualeffect.tidemark;

import androidx.annotation.NonNull;

/**
 * Looks with names.
 *
 * <p>Generated from {@code host/presets.ini}.
 */
public enum Preset {
    /** Clear lake. */
    CLEAR_LAKE("Clear lake", Ground.SHORE, true, false),
    /** Summer rain. */
    SUMMER_RAIN("Summer rain", Ground.POOL, false, true),
    /** Heavy glass. */
    HEAVY_GLASS("Heavy glass", Ground.POOL, false, false),
    /** Quicksilver. */
    QUICKSILVER("Quicksilver", Ground.SHORE, false, false),
    /** Honey. */
    HONEY("Honey", Ground.SHORE, true, false),
    /** Red ink. */
    RED_INK("Red ink", Ground.SHORE, true, false),
    /** Deep swell. */
    DEEP_SWELL("Deep swell", Ground.POOL, false, false);

    /** The picture under the water. */
    public enum Ground {
        /** Glazed tiles. */
        POOL,
        /** Pebbles. */
        RIVER,
        /** Ribbed sand. */
        SHORE
    }

    /** For people, in English. */
    @NonNull public final String title;

    /** The picture that suits the look. */
    @NonNull public final Ground ground;

    /** Whether touches drop ink. */
    public final boolean ink;

    /** Whether it rains. */
    public final boolean rain;

    Preset(String title, Ground ground, boolean ink, boolean rain) {
        this.title = title;
        this.ground = ground;
        this.ink = ink;
        this.rain = rain;
    }

    /**
     * The values.
     *
     * @return a look of its own
     */
    @NonNull
    public Look look() {
        Look look = new Look();
        switch (this) {
            case CLEAR_LAKE:
                look.breeze = 0.3f;
                look.groundRed = 0.6f;
                look.groundGreen = 0.92f;
                break;
            case SUMMER_RAIN:
                look.calmingTime = 3.6f;
                look.rainDropsPerSecond = 24;
                look.rainAmplitude = 0.9f;
                look.groundRed = 0.7f;
                look.groundGreen = 0.78f;
                look.groundBlue = 0.85f;
                break;
            case HEAVY_GLASS:
                look.refractiveIndex = 2.4f;
                look.calmingTime = 4;
                look.ringSpeed = 0.16f;
                look.exponent = 120;
                look.specularRatio = 8;
                look.alphaMix = 0.6f;
                look.rebound = 0;
                look.breeze = 0.1f;
                look.touchAmplitude = 4;
                look.groundRed = 0.75f;
                look.groundGreen = 0.95f;
                look.groundBlue = 0.85f;
                break;
            case QUICKSILVER:
                look.alphaMix = 0.9f;
                look.alphaScale1 = 0.9f;
                look.fresnelRatio = 2;
                look.specularRatio = 6;
                look.exponent = 25;
                look.touchAmplitude = 3;
                look.calmingTime = 10;
                look.ringSpeed = 0.22f;
                look.rebound = 0.8f;
                look.breeze = 0.4f;
                look.groundRed = 0.25f;
                look.groundGreen = 0.29f;
                look.groundBlue = 0.42f;
                look.lightGreen = 0.8f;
                look.lightBlue = 0.65f;
                break;
            case HONEY:
                look.calmingTime = 1.2f;
                look.ringSpeed = 0.12f;
                look.dropRadius = 0.034f;
                look.touchAmplitude = 3.4f;
                look.trailShare = 0.2f;
                look.alphaMix = 0.8f;
                look.exponent = 80;
                look.rebound = 0;
                look.breeze = 0;
                look.inkStepsPerSecond = 30;
                look.groundGreen = 0.66f;
                look.groundBlue = 0.2f;
                look.lightGreen = 0.8f;
                look.lightBlue = 0.4f;
                look.inkRed = 0.45f;
                look.inkGreen = 0.18f;
                look.inkBlue = 0.01f;
                break;
            case RED_INK:
                look.touchAmplitude = 1.2f;
                look.trailShare = 0.06f;
                look.inkStepsPerSecond = 30;
                look.inkRed = 0.6f;
                look.inkGreen = 0.03f;
                look.inkBlue = 0.05f;
                break;
            case DEEP_SWELL:
                look.dropRadius = 0.045f;
                look.meshExtent = 20;
                look.calmingTime = 12.5f;
                look.ringSpeed = 0.43f;
                look.touchAmplitude = 3;
                look.rebound = 0.5f;
                look.breeze = 0.5f;
                look.groundRed = 0.3f;
                look.groundGreen = 0.48f;
                look.groundBlue = 0.7f;
                break;
        }
        return look;
    }
}
