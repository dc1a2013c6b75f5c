package com.zor.android.visualeffect.tidemark;

import java.io.IOException;
import java.io.InputStream;

/**
 * How the water looks and moves. {@code docs/look.md} explains each value and gives the range in which it looks well.
 * Change the fields before you hand them on, or load them from a file that your app ships.
 */
public final class Look implements Cloneable {
    public int meshVertices = 0;
    public int meshExtent = 32;
    public float pictureZoom = 1.015f;
    public float ringSpeed = 0.2713f;
    public float dropRadius = 0.024f;
    public float calmingTime = 6.6f;
    public int stepsPerSecond = 60;
    public float longestFrame = 0.25f;
    public int stepsToRest = 30;
    public float damping = 0.0f;
    public float waveSpeed = 0.0f;
    public float refractiveIndex = 1.75f;
    public float alphaMix = 0.5f;
    public float alphaScale1 = 0.7f;
    public float alphaScale2 = 1.0f;
    public float fresnelRatio = 0.8f;
    public float specularRatio = 4.5f;
    public float exponent = 40.0f;
    public float touchAmplitude = 2.2f;
    public float trailCells = 1.5f;
    public float longestTrail = 200.0f;
    public float trailShare = 0.12f;
    public float rainAmplitude = 0.9f;
    public float rainDropsPerSecond = 3.0f;
    public float inkRed = 0.05f;
    public float inkGreen = 0.15f;
    public float inkBlue = 0.45f;
    public int framesToFade = 180;

    /**
     * Reads {@code key = number} lines, in the form of {@code java.util.Properties}. What they do not name keeps its
     * default.
     *
     * @throws IllegalArgumentException naming the key, when it is none of the fields above or when its value is not a
     *     number of the field's type or beyond its limits
     */
    public static Look load(InputStream text) throws IOException {
        LookFile values = new LookFile(text);
        Look look = new Look();
        look.meshVertices = values.whole("meshVertices", look.meshVertices, 0, 256);
        look.meshExtent = values.whole("meshExtent", look.meshExtent, 1, 1000);
        look.pictureZoom = values.real("pictureZoom", look.pictureZoom, 0.1f, 10);
        look.ringSpeed = values.real("ringSpeed", look.ringSpeed, 0.01f, 3);
        look.dropRadius = values.real("dropRadius", look.dropRadius, 0.01f, 0.3f);
        look.calmingTime = values.real("calmingTime", look.calmingTime, 0.1f, 1000);
        look.stepsPerSecond = values.whole("stepsPerSecond", look.stepsPerSecond, 1, 1000);
        look.longestFrame = values.real("longestFrame", look.longestFrame, 0, 10);
        look.stepsToRest = values.whole("stepsToRest", look.stepsToRest, 1, 10000);
        look.damping = values.real("damping", look.damping, 0, 1);
        look.waveSpeed = values.real("waveSpeed", look.waveSpeed, 0, 0.5f);
        look.refractiveIndex = values.real("refractiveIndex", look.refractiveIndex, 1, 10);
        look.alphaMix = values.real("alphaMix", look.alphaMix, 0, 10);
        look.alphaScale1 = values.real("alphaScale1", look.alphaScale1, 0, 10);
        look.alphaScale2 = values.real("alphaScale2", look.alphaScale2, 0, 10);
        look.fresnelRatio = values.real("fresnelRatio", look.fresnelRatio, 0, 100);
        look.specularRatio = values.real("specularRatio", look.specularRatio, 0, 100);
        look.exponent = values.real("exponent", look.exponent, 0, 1000);
        look.touchAmplitude = values.real("touchAmplitude", look.touchAmplitude, 0, 100);
        look.trailCells = values.real("trailCells", look.trailCells, 0.1f, 100);
        look.longestTrail = values.real("longestTrail", look.longestTrail, 0, 1000);
        look.trailShare = values.real("trailShare", look.trailShare, 0, 10);
        look.rainAmplitude = values.real("rainAmplitude", look.rainAmplitude, 0, 100);
        look.rainDropsPerSecond = values.real("rainDropsPerSecond", look.rainDropsPerSecond, 0, 1000);
        look.inkRed = values.real("inkRed", look.inkRed, 0, 1);
        look.inkGreen = values.real("inkGreen", look.inkGreen, 0, 1);
        look.inkBlue = values.real("inkBlue", look.inkBlue, 0, 1);
        look.framesToFade = values.whole("framesToFade", look.framesToFade, 0, 10000);
        values.expectNoOthers();
        return look;
    }

    @Override
    public Look clone() {
        try {
            return (Look) super.clone();
        } catch (CloneNotSupportedException e) {
            throw new AssertionError(e);
        }
    }
}
