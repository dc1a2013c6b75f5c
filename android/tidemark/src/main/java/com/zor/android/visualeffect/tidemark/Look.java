package com.zor.android.visualeffect.tidemark;

import androidx.annotation.NonNull;

import java.io.IOException;
import java.io.InputStream;
import java.util.Properties;

/**
 * Parameters of the water's appearance and motion. Each field has a recommended range, and limits outside which methods
 * that take a look throw an exception. Set the fields before you pass the object, or load them from a file in your app.
 *
 * <p>Generated from {@code host/look.properties}.
 */
public final class Look implements Cloneable {
    /**
     * Vertices along each side of the mesh that is drawn, at the cost of its square; it changes how fine the water is
     * drawn, not how it moves. 0 chooses by the size of the view and the time that frames take; 1 does the same.
     * Range 96 to 256, limits 0 to 256.
     */
    public int meshVertices = 0;
    /**
     * Height of the view in model units. The eye is 30 units away, so fewer bend the picture more.
     * Range 16 to 64, limits 1 to 1000.
     */
    public int meshExtent = 32;
    /**
     * How many times smaller than the mesh a flat surface shows the picture, which follows from the distances in the
     * vertex shader: the eye is 30 units before the surface, the picture 30.9 behind it. The view shows the part of
     * the mesh that the picture fills. Range 1 to 1.1, limits 0.1 to 10.
     */
    public float pictureZoom = 1.015f;
    /** Speed of rings, view heights a second. Range 0.05 to 1, limits 0.01 to 3. */
    public float ringSpeed = 0.2713f;
    /**
     * Radius of a drop, share of the view's height. The lattice on which the waves move has three cells in it.
     * Range 0.014 to 0.1, limits 0.01 to 0.3.
     */
    public float dropRadius = 0.024f;
    /** Seconds until waves have sunk to a twentieth. Range 1 to 40, limits 0.1 to 1000. */
    public float calmingTime = 6.6f;
    /**
     * Wave steps a second, whatever the frame rate; fast rings take several times as many.
     * Range 30 to 120, limits 1 to 1000.
     */
    public int stepsPerSecond = 60;
    /**
     * Longest time that one frame may bring, in seconds: after a pause the water goes on and does not catch up.
     * Range 0.05 to 1, limits 0 to 10.
     */
    public float longestFrame = 0.25f;
    /**
     * A wave's turning point is slow as well, so the water rests only after this many calm steps in a row.
     * Range 10 to 120, limits 1 to 10000.
     */
    public int stepsToRest = 30;
    /**
     * By hand instead of calmingTime: factor on every speed at each step. Smaller calms the water sooner; 0.94
     * exactly also smooths it more. 0 leaves it to calmingTime. Range 0.9 to 0.998, limits 0 to 1.
     */
    public float damping = 0.0f;
    /**
     * By hand instead of ringSpeed: factor on the curvature of the surface at each step. Above 0.5 the waves would
     * blow up. 0 leaves it to ringSpeed. Range 0.05 to 0.45, limits 0 to 0.5.
     */
    public float waveSpeed = 0.0f;
    /**
     * Refractive index of the water, 1 for no bending. Real water has 1.33, which a small screen hardly shows.
     * Range 1 to 2.5, limits 1 to 10.
     */
    public float refractiveIndex = 1.75f;
    /**
     * Share of the water texture on a wave; the texture's weight is alphaMix * alphaScale1.
     * Range 0 to 1, limits 0 to 10.
     */
    public float alphaMix = 0.5f;
    /** Scale of that share. Range 0 to 1, limits 0 to 10. */
    public float alphaScale1 = 0.7f;
    /** Scale of the other share. The shaders of today do not read it. Range 0 to 1, limits 0 to 10. */
    public float alphaScale2 = 1.0f;
    /** Extra light on slopes that face the light. Range 0 to 2, limits 0 to 100. */
    public float fresnelRatio = 0.8f;
    /**
     * Strength of the highlights; the picture takes up to 5.5 of it, with ink up to 4.5, so more only widens them.
     * Range 1 to 10, limits 0 to 100.
     */
    public float specularRatio = 4.5f;
    /** Sharpness of the highlights, from broad to pinpoint. Range 1 to 200, limits 0 to 1000. */
    public float exponent = 40.0f;
    /**
     * A third of the height of the ripple that a touch of pressure 1 raises; heights of 1.13 and more show the water
     * texture fully. Range 0.2 to 4, limits 0 to 100.
     */
    public float touchAmplitude = 2.2f;
    /**
     * A finger that moves raises one ripple every so many thirds of a drop's radius. Range 0.5 to 5, limits 0.1 to 100.
     */
    public float trailCells = 1.5f;
    /** Most ripples that one move may raise. Range 20 to 500, limits 0 to 1000. */
    public float longestTrail = 200.0f;
    /** Height of these ripples as a share of a touch's. Range 0 to 1, limits 0 to 10. */
    public float trailShare = 0.12f;
    /** A third of the height of the ripple that the largest drop of rain raises. Range 0.2 to 2, limits 0 to 100. */
    public float rainAmplitude = 0.9f;
    /**
     * Crest and crater that follow a drop, as a share of what came before: fine rings instead of one broad one.
     * Range 0 to 0.9, limits 0 to 1.
     */
    public float rebound = 0.7f;
    /**
     * Height of the waves of a breeze, which rises with a touch and sinks some seconds later. 0 for none.
     * Range 0 to 0.5, limits 0 to 10.
     */
    public float breeze = 0.2f;
    /** Drops of rain a second. Range 0 to 60, limits 0 to 1000. */
    public float rainDropsPerSecond = 3.0f;
    /**
     * How much darker and cooler a bright picture is handed over, so that highlights show on it; a dark one stays as it is.
     * Range 0 to 1, limits 0 to 1.
     */
    public float wet = 0.6f;
    /** Share of the ground's red that the water lets through. Range 0 to 1, limits 0 to 1. */
    public float groundRed = 1.0f;
    /** Share of its green. Range 0 to 1, limits 0 to 1. */
    public float groundGreen = 1.0f;
    /** Share of its blue. Range 0 to 1, limits 0 to 1. */
    public float groundBlue = 1.0f;
    /** Red of the light on the waves, as a share of its picture's. Range 0 to 1, limits 0 to 1. */
    public float lightRed = 1.0f;
    /** Green of that light. Range 0 to 1, limits 0 to 1. */
    public float lightGreen = 1.0f;
    /** Blue of that light. Range 0 to 1, limits 0 to 1. */
    public float lightBlue = 1.0f;
    /** Red of the ink. Ink of more than 0.75 would light the picture up. Range 0 to 0.75, limits 0 to 1. */
    public float inkRed = 0.05f;
    /** Green of the ink. Range 0 to 0.75, limits 0 to 1. */
    public float inkGreen = 0.09f;
    /** Blue of the ink. Range 0 to 0.75, limits 0 to 1. */
    public float inkBlue = 0.24f;
    /**
     * Steps of the ink a second. Each needs a frame, and while ink lives there are no others: fewer steps make the ink slower
     * and the water less smooth. A tap takes as many steps whatever their number. Range 24 to 60, limits 10 to 120.
     */
    public int inkStepsPerSecond = 60;
    /**
     * Steps of the ink after the last touch until it has faded below the smallest
     * step of its texture: the slowest preset keeps 0.94 of it a step, and 127 * 0.94^n &lt; 1 / 255 for n = 168.
     * Range 168 to 300, limits 0 to 10000.
     */
    public int framesToFade = 180;

    /** Called for each field; returns its new value. */
    interface Values {
        double next(String name, double value, double least, double most, boolean isWhole);
    }

    /**
     * Reads {@code key = number} lines in the format of {@code java.util.Properties}. Fields without a line keep their
     * defaults.
     *
     * @param text the lines; not closed
     * @return a new look
     * @throws IOException if the text cannot be read
     * @throws IllegalArgumentException if a key is not a field, or its value is not a number of the field's type within
     *     the limits; the message names the key
     */
    @NonNull
    public static Look load(@NonNull InputStream text) throws IOException {
        LookFile file = new LookFile(text);
        Look look = new Look();
        look.forEach(file);
        file.expectAllRead();
        return look;
    }

    /**
     * Converts the look to properties that {@link #load} can read.
     *
     * @return a new object with all fields
     */
    @NonNull
    public Properties toProperties() {
        Properties properties = new Properties();
        forEach((name, value, least, most, isWhole) -> {
            properties.setProperty(name, isWhole ? Integer.toString((int) value) : Float.toString((float) value));
            return value;
        });
        return properties;
    }

    void forEach(Values values) {
        meshVertices = (int) values.next("meshVertices", meshVertices, 0, 256, true);
        meshExtent = (int) values.next("meshExtent", meshExtent, 1, 1000, true);
        pictureZoom = (float) values.next("pictureZoom", pictureZoom, 0.1f, 10f, false);
        ringSpeed = (float) values.next("ringSpeed", ringSpeed, 0.01f, 3f, false);
        dropRadius = (float) values.next("dropRadius", dropRadius, 0.01f, 0.3f, false);
        calmingTime = (float) values.next("calmingTime", calmingTime, 0.1f, 1000f, false);
        stepsPerSecond = (int) values.next("stepsPerSecond", stepsPerSecond, 1, 1000, true);
        longestFrame = (float) values.next("longestFrame", longestFrame, 0f, 10f, false);
        stepsToRest = (int) values.next("stepsToRest", stepsToRest, 1, 10000, true);
        damping = (float) values.next("damping", damping, 0f, 1f, false);
        waveSpeed = (float) values.next("waveSpeed", waveSpeed, 0f, 0.5f, false);
        refractiveIndex = (float) values.next("refractiveIndex", refractiveIndex, 1f, 10f, false);
        alphaMix = (float) values.next("alphaMix", alphaMix, 0f, 10f, false);
        alphaScale1 = (float) values.next("alphaScale1", alphaScale1, 0f, 10f, false);
        alphaScale2 = (float) values.next("alphaScale2", alphaScale2, 0f, 10f, false);
        fresnelRatio = (float) values.next("fresnelRatio", fresnelRatio, 0f, 100f, false);
        specularRatio = (float) values.next("specularRatio", specularRatio, 0f, 100f, false);
        exponent = (float) values.next("exponent", exponent, 0f, 1000f, false);
        touchAmplitude = (float) values.next("touchAmplitude", touchAmplitude, 0f, 100f, false);
        trailCells = (float) values.next("trailCells", trailCells, 0.1f, 100f, false);
        longestTrail = (float) values.next("longestTrail", longestTrail, 0f, 1000f, false);
        trailShare = (float) values.next("trailShare", trailShare, 0f, 10f, false);
        rainAmplitude = (float) values.next("rainAmplitude", rainAmplitude, 0f, 100f, false);
        rebound = (float) values.next("rebound", rebound, 0f, 1f, false);
        breeze = (float) values.next("breeze", breeze, 0f, 10f, false);
        rainDropsPerSecond = (float) values.next("rainDropsPerSecond", rainDropsPerSecond, 0f, 1000f, false);
        wet = (float) values.next("wet", wet, 0f, 1f, false);
        groundRed = (float) values.next("groundRed", groundRed, 0f, 1f, false);
        groundGreen = (float) values.next("groundGreen", groundGreen, 0f, 1f, false);
        groundBlue = (float) values.next("groundBlue", groundBlue, 0f, 1f, false);
        lightRed = (float) values.next("lightRed", lightRed, 0f, 1f, false);
        lightGreen = (float) values.next("lightGreen", lightGreen, 0f, 1f, false);
        lightBlue = (float) values.next("lightBlue", lightBlue, 0f, 1f, false);
        inkRed = (float) values.next("inkRed", inkRed, 0f, 1f, false);
        inkGreen = (float) values.next("inkGreen", inkGreen, 0f, 1f, false);
        inkBlue = (float) values.next("inkBlue", inkBlue, 0f, 1f, false);
        inkStepsPerSecond = (int) values.next("inkStepsPerSecond", inkStepsPerSecond, 10, 120, true);
        framesToFade = (int) values.next("framesToFade", framesToFade, 0, 10000, true);
    }

    /** Returns the value; throws {@code IllegalArgumentException} if it is NaN or outside its limits. */
    static double checked(String name, double value, double least, double most, boolean isWhole) {
        if (value >= least && value <= most) return value;
        throw new IllegalArgumentException(
                name + " must be " + (float) least + " to " + (float) most + ", not " + (float) value);
    }

    /** Returns whether the other object is a look with the same values. */
    @Override
    public boolean equals(Object other) {
        return other instanceof Look && toProperties().equals(((Look) other).toProperties());
    }

    @Override
    public int hashCode() {
        return toProperties().hashCode();
    }

    /** Returns an independent copy. */
    @NonNull
    @Override
    public Look clone() {
        try {
            return (Look) super.clone();
        } catch (CloneNotSupportedException e) {
            throw new AssertionError(e);
        }
    }
}
