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
     * Vertices along each side of the drawn mesh; the cost grows with their square. It affects only the detail of
     * the drawing, not the motion of the water. 0 and 1 choose the number by the view's size and the time of
     * frames. Range 96 to 256, limits 0 to 256.
     */
    public int meshVertices = 0;
    /**
     * Height of the view in model units. The eye is 30 units in front of the water, so a smaller height increases
     * the refraction. Range 16 to 64, limits 1 to 1000.
     */
    public int meshExtent = 32;
    /**
     * Factor by which a flat surface shows the picture smaller than the mesh. It follows from the distances in the
     * vertex shader: the eye is 30 units in front of the surface, the picture 30.9 behind it.
     * Range 1 to 1.1, limits 0.1 to 10.
     */
    public float pictureZoom = 1.015f;
    /** Speed of rings in view heights per second. Range 0.05 to 1, limits 0.01 to 3. */
    public float ringSpeed = 0.2713f;
    /**
     * Radius of a drop as a fraction of the view's height. A lattice cell is a third of it.
     * Range 0.014 to 0.1, limits 0.01 to 0.3.
     */
    public float dropRadius = 0.024f;
    /** Time in seconds in which waves decay to 5 %. Range 1 to 40, limits 0.1 to 1000. */
    public float calmingTime = 6.6f;
    /**
     * Wave steps per second, whatever the frame rate. Fast rings use a multiple of it.
     * Range 30 to 120, limits 1 to 1000.
     */
    public int stepsPerSecond = 60;
    /**
     * Longest time in seconds by which one frame advances the water. After a longer pause the water does not catch
     * up. Range 0.05 to 1, limits 0 to 10.
     */
    public float longestFrame = 0.25f;
    /**
     * Number of successive calm steps before the water rests. A single calm step does not suffice, because waves
     * are slow at their turning points. Range 10 to 120, limits 1 to 10000.
     */
    public int stepsToRest = 30;
    /**
     * Factor on every speed per step, instead of calmingTime. A smaller value calms the water sooner; exactly 0.94
     * also smooths it more. 0 uses calmingTime. Range 0.9 to 0.998, limits 0 to 1.
     */
    public float damping = 0.0f;
    /**
     * Factor on the surface's curvature per step, instead of ringSpeed. Waves are unstable above 0.5. 0 uses
     * ringSpeed. Range 0.05 to 0.45, limits 0 to 0.5.
     */
    public float waveSpeed = 0.0f;
    /**
     * Refractive index of the water; 1 does not refract. Real water has 1.33, which is hardly visible on a small
     * screen. Range 1 to 2.5, limits 1 to 10.
     */
    public float refractiveIndex = 1.75f;
    /**
     * Weight of the light's picture on a wave. The weight in the shader is alphaMix * alphaScale1.
     * Range 0 to 1, limits 0 to 10.
     */
    public float alphaMix = 0.5f;
    /** Factor on alphaMix. Range 0 to 1, limits 0 to 10. */
    public float alphaScale1 = 0.7f;
    /** Factor on 1 - alphaMix. The current shaders do not use it. Range 0 to 1, limits 0 to 10. */
    public float alphaScale2 = 1.0f;
    /** Additional light on slopes that face the light. Range 0 to 2, limits 0 to 100. */
    public float fresnelRatio = 0.8f;
    /**
     * Strength of the highlights. The picture is saturated at 5.5, with ink at 4.5; larger values only widen the
     * highlights. Range 1 to 10, limits 0 to 100.
     */
    public float specularRatio = 4.5f;
    /** Exponent of the highlights: small values are broad, large values sharp. Range 1 to 200, limits 0 to 1000. */
    public float exponent = 40.0f;
    /**
     * Amplitude of the ripple of a touch with pressure 1; the peak is three times as high. At heights of 1.13 and
     * above the light's picture has its full weight. Range 0.2 to 4, limits 0 to 100.
     */
    public float touchAmplitude = 2.2f;
    /** Distance between the ripples of a moving finger, in thirds of dropRadius. Range 0.5 to 5, limits 0.1 to 100. */
    public float trailCells = 1.5f;
    /** Limit of the ripples of one move. Range 20 to 500, limits 0 to 1000. */
    public float longestTrail = 200.0f;
    /** Amplitude of these ripples as a fraction of touchAmplitude. Range 0 to 1, limits 0 to 10. */
    public float trailShare = 0.12f;
    /**
     * Amplitude of the ripple of the largest raindrops; the peak is three times as high.
     * Range 0.2 to 2, limits 0 to 100.
     */
    public float rainAmplitude = 0.9f;
    /**
     * Amplitude of the crater and the second crest after a drop, each as a fraction of the preceding one. It makes
     * several narrow rings instead of a broad one. Range 0 to 0.9, limits 0 to 1.
     */
    public float rebound = 0.7f;
    /**
     * Height of the breeze's waves. The breeze begins with a touch and ends some seconds later. 0 disables it.
     * Range 0 to 0.5, limits 0 to 10.
     */
    public float breeze = 0.2f;
    /** Raindrops per second. Range 0 to 60, limits 0 to 1000. */
    public float rainDropsPerSecond = 3.0f;
    /**
     * Strength with which bright pictures are darkened and cooled, so that highlights are visible on them. Dark
     * pictures do not change. Range 0 to 1, limits 0 to 1.
     */
    public float wet = 0.6f;
    /** Factor on the red of the background. Range 0 to 1, limits 0 to 1. */
    public float groundRed = 1.0f;
    /** Factor on the green of the background. Range 0 to 1, limits 0 to 1. */
    public float groundGreen = 1.0f;
    /** Factor on the blue of the background. Range 0 to 1, limits 0 to 1. */
    public float groundBlue = 1.0f;
    /** Factor on the red of the light's picture. Range 0 to 1, limits 0 to 1. */
    public float lightRed = 1.0f;
    /** Factor on the green of the light's picture. Range 0 to 1, limits 0 to 1. */
    public float lightGreen = 1.0f;
    /** Factor on the blue of the light's picture. Range 0 to 1, limits 0 to 1. */
    public float lightBlue = 1.0f;
    /** Red of the ink. Ink above 0.75 would brighten the picture. Range 0 to 0.75, limits 0 to 1. */
    public float inkRed = 0.05f;
    /** Green of the ink. Range 0 to 0.75, limits 0 to 1. */
    public float inkGreen = 0.09f;
    /** Blue of the ink. Range 0 to 0.75, limits 0 to 1. */
    public float inkBlue = 0.24f;
    /**
     * Ink steps per second. While there is ink, frames are drawn only for its steps, so fewer steps slow the ink
     * and make the water less smooth. A tap takes the same number of steps in any case.
     * Range 24 to 60, limits 10 to 120.
     */
    public int inkStepsPerSecond = 60;
    /**
     * Number of ink steps after the last touch until the ink has faded below the smallest value of its texture.
     * The slowest preset keeps 0.94 per step, and 127 * 0.94^n &lt; 1 / 255 for n = 168.
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
