package com.zor.android.visualeffect.tidemark;

import androidx.annotation.NonNull;

import java.util.Arrays;
import java.util.List;

/**
 * Looks with names, each with the ink and the rain that suit it.
 *
 * <p>Generated from {@code host/presets.ini}.
 */
public enum Preset {
    /** Clear lake. */
    CLEAR_LAKE("Clear lake", true, false,
            "breeze", 0.3, "groundRed", 0.6, "groundGreen", 0.92),
    /** Summer rain. */
    SUMMER_RAIN("Summer rain", false, true,
            "calmingTime", 3.6, "rainDropsPerSecond", 24, "rainAmplitude", 0.9, "groundRed", 0.7,
            "groundGreen", 0.78, "groundBlue", 0.85),
    /** Heavy glass. */
    HEAVY_GLASS("Heavy glass", false, false,
            "refractiveIndex", 2.4, "calmingTime", 4, "ringSpeed", 0.16, "exponent", 120,
            "specularRatio", 8, "alphaMix", 0.6, "rebound", 0, "breeze", 0.1,
            "touchAmplitude", 4, "groundRed", 0.75, "groundGreen", 0.95, "groundBlue", 0.85),
    /** Quicksilver. */
    QUICKSILVER("Quicksilver", false, false,
            "alphaMix", 0.9, "alphaScale1", 0.9, "fresnelRatio", 2, "specularRatio", 6,
            "exponent", 25, "touchAmplitude", 3, "calmingTime", 10, "ringSpeed", 0.22,
            "rebound", 0.8, "breeze", 0.4, "groundRed", 0.25, "groundGreen", 0.29,
            "groundBlue", 0.42, "lightGreen", 0.8, "lightBlue", 0.65),
    /** Honey. */
    HONEY("Honey", true, false,
            "calmingTime", 1.2, "ringSpeed", 0.12, "dropRadius", 0.034, "touchAmplitude", 3.4,
            "trailShare", 0.2, "alphaMix", 0.8, "exponent", 80, "rebound", 0,
            "breeze", 0, "inkStepsPerSecond", 30, "groundGreen", 0.66, "groundBlue", 0.2,
            "lightGreen", 0.8, "lightBlue", 0.4, "inkRed", 0.45, "inkGreen", 0.18,
            "inkBlue", 0.01),
    /** Red ink. */
    RED_INK("Red ink", true, false,
            "touchAmplitude", 1.2, "trailShare", 0.06, "inkStepsPerSecond", 30, "inkRed", 0.6,
            "inkGreen", 0.03, "inkBlue", 0.05),
    /** Deep swell. */
    DEEP_SWELL("Deep swell", false, false,
            "dropRadius", 0.045, "meshExtent", 20, "calmingTime", 12.5, "ringSpeed", 0.43,
            "touchAmplitude", 3, "rebound", 0.5, "breeze", 0.5, "groundRed", 0.3,
            "groundGreen", 0.48, "groundBlue", 0.7);

    /** The name that an app may show, in English. */
    @NonNull public final String title;

    /** Whether touches drop ink. */
    public final boolean ink;

    /** Whether it rains. */
    public final boolean rain;

    private final List<Object> values;  // names and numbers by turns, of the fields that differ from a new look's

    Preset(String title, boolean ink, boolean rain, Object... values) {
        this.title = title;
        this.ink = ink;
        this.rain = rain;
        this.values = Arrays.asList(values);
    }

    /**
     * Creates the look of this preset.
     *
     * @return a new object, which the caller may change
     */
    @NonNull
    public Look look() {
        Look look = new Look();
        look.forEach((name, value, least, most, isWhole) -> {
            int i = values.indexOf(name);
            return i < 0 ? value : ((Number) values.get(i + 1)).doubleValue();
        });
        return look;
    }
}
