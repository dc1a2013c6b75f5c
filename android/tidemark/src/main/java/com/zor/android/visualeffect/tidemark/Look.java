package com.zor.android.visualeffect.tidemark;

import java.io.IOException;
import java.io.InputStream;
import java.util.Properties;

/**
 * How the water looks and moves: the numbers of {@code look.properties}, where each is explained. Change the fields
 * before you hand them on.
 */
public final class Look {
    public int meshVertices;
    public int meshExtent;
    public float pictureZoom;
    public int stepsPerSecond;
    public float longestFrame;
    public int stepsToRest;
    public float damping;
    public float waveSpeed;
    public float refractiveIndex;
    public float alphaMix;
    public float alphaScale1;
    public float alphaScale2;
    public float fresnelRatio;
    public float specularRatio;
    public float exponent;
    public float touchAmplitude;
    public float trailCells;
    public float longestTrail;
    public float trailShare;
    public float rainAmplitude;
    public float rainDropsPerSecond;
    public float inkRed;
    public float inkGreen;
    public float inkBlue;
    public int framesToFade;

    // A whole path: a shrinker may move the class to another package, but not the file.
    private static final String FILE = "/com/zor/android/visualeffect/tidemark/look.properties";

    public Look() {
        Properties file = read();
        meshVertices = whole(file, "meshVertices");
        meshExtent = whole(file, "meshExtent");
        pictureZoom = real(file, "pictureZoom");
        stepsPerSecond = whole(file, "stepsPerSecond");
        longestFrame = real(file, "longestFrame");
        stepsToRest = whole(file, "stepsToRest");
        damping = real(file, "damping");
        waveSpeed = real(file, "waveSpeed");
        refractiveIndex = real(file, "refractiveIndex");
        alphaMix = real(file, "alphaMix");
        alphaScale1 = real(file, "alphaScale1");
        alphaScale2 = real(file, "alphaScale2");
        fresnelRatio = real(file, "fresnelRatio");
        specularRatio = real(file, "specularRatio");
        exponent = real(file, "exponent");
        touchAmplitude = real(file, "touchAmplitude");
        trailCells = real(file, "trailCells");
        longestTrail = real(file, "longestTrail");
        trailShare = real(file, "trailShare");
        rainAmplitude = real(file, "rainAmplitude");
        rainDropsPerSecond = real(file, "rainDropsPerSecond");
        inkRed = real(file, "inkRed");
        inkGreen = real(file, "inkGreen");
        inkBlue = real(file, "inkBlue");
        framesToFade = whole(file, "framesToFade");
    }

    private static Properties read() {
        Properties file = new Properties();
        try (InputStream text = Look.class.getResourceAsStream(FILE)) {
            if (text == null) throw new IOException(FILE + " is not packaged");
            file.load(text);
        } catch (IOException e) {
            throw new IllegalStateException(e);
        }
        return file;
    }

    private static int whole(Properties file, String key) {
        return Integer.parseInt(file.getProperty(key));
    }

    private static float real(Properties file, String key) {
        return Float.parseFloat(file.getProperty(key));
    }
}
