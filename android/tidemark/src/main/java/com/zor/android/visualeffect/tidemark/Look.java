package com.zor.android.visualeffect.tidemark;

import org.jetbrains.annotations.NotNull;

import java.io.IOException;
import java.io.InputStream;
import java.util.Properties;

/**
 * How the water looks and moves. Each value has a range in which it looks well; {@code docs/look.md} has its limits.
 * Change the fields before you hand them on, or load them from a file that your app ships.
 */
public final class Look implements Cloneable {
    /**
     * Vertices along each side of the mesh that is drawn, at the cost of its square; it changes how fine the water is
     * drawn, not how it moves. Range 96 to 256; 0 chooses by the size of the view and the time that frames take.
     */
    public int meshVertices = 0;
    /** Height of the view in model units. Range 16 to 64. */
    public int meshExtent = 32;
    /**
     * How many times smaller than the mesh a flat surface shows the picture, which follows from the distances in the
     * vertex shader. The view shows the part of the mesh that the picture fills. Range 1 to 1.1.
     */
    public float pictureZoom = 1.015f;
    /** Speed of rings, view heights a second. Range 0.05 to 1. */
    public float ringSpeed = 0.2713f;
    /** Radius of a drop, share of the view's height. Range 0.014 to 0.1. */
    public float dropRadius = 0.024f;
    /** Seconds until waves have sunk to a twentieth. Range 1 to 40. */
    public float calmingTime = 6.6f;
    /** Wave steps a second, whatever the frame rate; fast rings take several times as many. Range 30 to 120. */
    public int stepsPerSecond = 60;
    /**
     * Longest time that one frame may bring, in seconds: after a pause the water goes on and does not catch up. Range
     * 0.05 to 1.
     */
    public float longestFrame = 0.25f;
    /**
     * A wave's turning point is slow as well, so the water rests only after this many calm steps in a row. Range 10 to
     * 120.
     */
    public int stepsToRest = 30;
    /** By hand instead of calmingTime: factor on every speed at each step; 0 for not. Range 0.9 to 0.998. */
    public float damping = 0.0f;
    /**
     * By hand instead of ringSpeed: factor on the curvature of the surface at each step; 0 for not. Range 0.05 to 0.45.
     */
    public float waveSpeed = 0.0f;
    /** Refractive index of the water, 1 for no bending. Range 1 to 2.5. */
    public float refractiveIndex = 1.75f;
    /** Share of the water texture on a wave; the texture's weight is alphaMix * alphaScale1. Range 0 to 1. */
    public float alphaMix = 0.5f;
    /** Scale of that share. Range 0 to 1. */
    public float alphaScale1 = 0.7f;
    /** Scale of the other share. Range 0 to 1. */
    public float alphaScale2 = 1.0f;
    /** Extra light on slopes that face the light. Range 0 to 2. */
    public float fresnelRatio = 0.8f;
    /**
     * Strength of the highlights; the picture takes up to 5.5 of it, with ink up to 4.5, so more only widens them.
     * Range 1 to 10.
     */
    public float specularRatio = 4.5f;
    /** Sharpness of the highlights, from broad to pinpoint. Range 1 to 200. */
    public float exponent = 40.0f;
    /**
     * A third of the height of the ripple that a touch of pressure 1 raises; heights of 1.13 and more show the water
     * texture fully. Range 0.2 to 4.
     */
    public float touchAmplitude = 2.2f;
    /** A finger that moves raises one ripple every so many thirds of a drop's radius. Range 0.5 to 5. */
    public float trailCells = 1.5f;
    /** Most ripples that one move may raise. Range 20 to 500. */
    public float longestTrail = 200.0f;
    /** Height of these ripples as a share of a touch's. Range 0 to 1. */
    public float trailShare = 0.12f;
    /** A third of the height of the ripple that the largest drop of rain raises. Range 0.2 to 2. */
    public float rainAmplitude = 0.9f;
    /** Drops of rain a second. Range 0 to 60. */
    public float rainDropsPerSecond = 3.0f;
    /** Red of the ink. Range 0 to 0.75. */
    public float inkRed = 0.05f;
    /** Green of the ink. Range 0 to 0.75. */
    public float inkGreen = 0.15f;
    /** Blue of the ink. Range 0 to 0.75. */
    public float inkBlue = 0.45f;
    /**
     * Steps of the ink, of which there are 60 a second, after the last touch until it has faded. Range 168 to 300.
     */
    public int framesToFade = 180;

    /** Each value by its name and with its limits; gives back the one to go on with. */
    interface Values {
        int whole(String name, int value, int least, int most);

        float real(String name, float value, float least, float most);
    }

    /**
     * Reads {@code key = number} lines, in the form of {@code java.util.Properties}. What they do not name keeps its
     * default.
     *
     * @param text stays open
     * @return a look of its own
     * @throws IOException where the text cannot be read
     * @throws IllegalArgumentException naming the key, when it is none of the fields above or when its value is not a
     *     number of the field's type or beyond its limits
     */
    @NotNull
    public static Look load(@NotNull InputStream text) throws IOException {
        LookFile file = new LookFile(text);
        Look look = new Look();
        look.replaceAll(file);
        file.expectNoOthers();
        return look;
    }

    /**
     * The way back of {@link #load}.
     *
     * @return all values, for {@code Properties.store} to write
     */
    @NotNull
    public Properties toProperties() {
        Properties properties = new Properties();
        clone().replaceAll(new Values() {
            @Override
            public int whole(String name, int value, int least, int most) {
                properties.setProperty(name, Integer.toString(value));
                return value;
            }

            @Override
            public float real(String name, float value, float least, float most) {
                properties.setProperty(name, Float.toString(value));
                return value;
            }
        });
        return properties;
    }

    /** A copy with every value brought within its limits; one that is not a number takes the lower limit. */
    Look withinLimits() {
        Look copy = clone();
        copy.replaceAll(new Values() {
            @Override
            public int whole(String name, int value, int least, int most) {
                return Math.max(least, Math.min(value, most));
            }

            @Override
            public float real(String name, float value, float least, float most) {
                return value >= least ? Math.min(value, most) : least;
            }
        });
        return copy;
    }

    private void replaceAll(Values values) {
        meshVertices = values.whole("meshVertices", meshVertices, 0, 256);
        meshExtent = values.whole("meshExtent", meshExtent, 1, 1000);
        pictureZoom = values.real("pictureZoom", pictureZoom, 0.1f, 10);
        ringSpeed = values.real("ringSpeed", ringSpeed, 0.01f, 3);
        dropRadius = values.real("dropRadius", dropRadius, 0.01f, 0.3f);
        calmingTime = values.real("calmingTime", calmingTime, 0.1f, 1000);
        stepsPerSecond = values.whole("stepsPerSecond", stepsPerSecond, 1, 1000);
        longestFrame = values.real("longestFrame", longestFrame, 0, 10);
        stepsToRest = values.whole("stepsToRest", stepsToRest, 1, 10000);
        damping = values.real("damping", damping, 0, 1);
        waveSpeed = values.real("waveSpeed", waveSpeed, 0, 0.5f);
        refractiveIndex = values.real("refractiveIndex", refractiveIndex, 1, 10);
        alphaMix = values.real("alphaMix", alphaMix, 0, 10);
        alphaScale1 = values.real("alphaScale1", alphaScale1, 0, 10);
        alphaScale2 = values.real("alphaScale2", alphaScale2, 0, 10);
        fresnelRatio = values.real("fresnelRatio", fresnelRatio, 0, 100);
        specularRatio = values.real("specularRatio", specularRatio, 0, 100);
        exponent = values.real("exponent", exponent, 0, 1000);
        touchAmplitude = values.real("touchAmplitude", touchAmplitude, 0, 100);
        trailCells = values.real("trailCells", trailCells, 0.1f, 100);
        longestTrail = values.real("longestTrail", longestTrail, 0, 1000);
        trailShare = values.real("trailShare", trailShare, 0, 10);
        rainAmplitude = values.real("rainAmplitude", rainAmplitude, 0, 100);
        rainDropsPerSecond = values.real("rainDropsPerSecond", rainDropsPerSecond, 0, 1000);
        inkRed = values.real("inkRed", inkRed, 0, 1);
        inkGreen = values.real("inkGreen", inkGreen, 0, 1);
        inkBlue = values.real("inkBlue", inkBlue, 0, 1);
        framesToFade = values.whole("framesToFade", framesToFade, 0, 10000);
    }

    /** A look of its own, so that later changes do not reach the other. */
    @NotNull
    @Override
    public Look clone() {
        try {
            return (Look) super.clone();
        } catch (CloneNotSupportedException e) {
            throw new AssertionError(e);
        }
    }
}
