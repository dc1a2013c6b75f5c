package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import org.junit.Test;

import java.io.ByteArrayInputStream;
import java.io.ByteArrayOutputStream;
import java.io.IOException;
import java.util.Properties;

/** Looks as files, invalid values, and presets. */
public final class LookTest {
    @Test
    public void everyValueCanBeStoredAndLoaded() throws IOException {
        Properties limits = new Properties();
        new Look().forEach((name, value, least, most, isWhole) -> {
            limits.setProperty(name, isWhole ? Integer.toString((int) most) : Float.toString((float) most));
            return value;
        });
        ByteArrayOutputStream stored = new ByteArrayOutputStream();
        limits.store(stored, null);
        assertEquals(limits, load(stored.toString()).toProperties());
        assertEquals(new Look().toProperties(), load("").toProperties());
    }

    @Test
    public void anInvalidValueIsNamed() {
        for (String text : new String[] {"damping = 1.001", "damping = -0.001", "damping = 0.9f", "damping = NaN",
                "meshVertices = 2.5", "meshVertices = 257", "dampening = 0.9"}) {
            String key = text.substring(0, text.indexOf(' '));
            String message = assertThrows(text, IllegalArgumentException.class, () -> load(text)).getMessage();
            assertTrue(message, message.contains(key));
        }
    }

    @Test
    public void aPresetChangesTheValuesOfItsTableAlone() {
        Look expected = new Look();
        expected.touchAmplitude = 1.2f;
        expected.trailShare = 0.06f;
        expected.inkStepsPerSecond = 30;
        expected.inkRed = 0.6f;
        expected.inkGreen = 0.03f;
        expected.inkBlue = 0.05f;
        assertEquals(expected, Preset.RED_INK.look());
    }

    private static Look load(String text) throws IOException {
        return Look.load(new ByteArrayInputStream(text.getBytes()));
    }
}
