package com.zor.android.visualeffect.tidemark;

import org.jetbrains.annotations.NotNull;

/**
 * Looks with names.
 *
 * <p>Generated from {@code host/presets.ini}.
 */
public enum Preset {
    /** Clear lake. */
    CLEAR_LAKE("Clear lake", Ground.POOL, false, false),
    /** Summer rain. */
    SUMMER_RAIN("Summer rain", Ground.SHORE, false, true),
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

    /** What the water lies over. */
    public enum Ground {
        /** Glazed tiles. */
        POOL,
        /** Pebbles. */
        RIVER,
        /** Ribbed sand. */
        SHORE
    }

    /** For people, in English. */
    @NotNull public final String title;

    /** The picture that suits the look. */
    @NotNull public final Ground ground;

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
    @NotNull
    public Look look() {
        Look look = new Look();
        switch (this) {
            case CLEAR_LAKE:
                break;
            case SUMMER_RAIN:
                look.calmingTime = 3.6f;
                look.rainDropsPerSecond = 16;
                look.rainAmplitude = 0.72f;
                break;
            case HEAVY_GLASS:
                look.refractiveIndex = 2.4f;
                look.calmingTime = 2.5f;
                look.ringSpeed = 0.2f;
                look.exponent = 120;
                look.specularRatio = 8;
                break;
            case QUICKSILVER:
                look.alphaMix = 0.8f;
                look.alphaScale1 = 0.8f;
                look.fresnelRatio = 1.2f;
                look.specularRatio = 6;
                look.exponent = 60;
                look.touchAmplitude = 3;
                look.calmingTime = 10;
                break;
            case HONEY:
                look.calmingTime = 1.6f;
                look.ringSpeed = 0.17f;
                look.touchAmplitude = 3.4f;
                look.alphaMix = 0.8f;
                look.inkRed = 0.6f;
                look.inkGreen = 0.302f;
                look.inkBlue = 0.02f;
                break;
            case RED_INK:
                look.touchAmplitude = 1.2f;
                look.trailShare = 0.06f;
                look.inkRed = 0.6f;
                look.inkGreen = 0.031f;
                look.inkBlue = 0.051f;
                break;
            case DEEP_SWELL:
                look.dropRadius = 0.032f;
                look.meshExtent = 20;
                look.calmingTime = 12.5f;
                look.ringSpeed = 0.43f;
                look.touchAmplitude = 3;
                break;
        }
        return look;
    }
}
