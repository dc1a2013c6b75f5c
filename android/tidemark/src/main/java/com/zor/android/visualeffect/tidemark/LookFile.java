package com.zor.android.visualeffect.tidemark;

import java.io.IOException;
import java.io.InputStream;
import java.util.Properties;

/** The numbers of a file, each taken once. */
final class LookFile implements Look.Values {
    private static final String WHOLE = "[-+]?\\d+";
    private static final String REAL = "[-+]?(\\d+\\.?\\d*|\\.\\d+)([eE][-+]?\\d+)?";

    private final Properties left = new Properties();

    LookFile(InputStream text) throws IOException {
        left.load(text);
    }

    @Override
    public int whole(String key, int usual, int least, int most) {
        return (int) take(key, WHOLE, usual, least, most);
    }

    @Override
    public float real(String key, float usual, float least, float most) {
        return take(key, REAL, usual, least, most);
    }

    void expectNoOthers() {
        for (Object key : left.keySet()) throw new IllegalArgumentException("there is no value \"" + key + "\"");
    }

    private float take(String key, String form, float usual, float least, float most) {
        Object found = left.remove(key);
        if (found == null) return usual;
        String text = found.toString().trim();
        if (!text.matches(form)) throw new IllegalArgumentException(key + " takes no \"" + text + "\"");
        float value = Float.parseFloat(text);
        if (value < least || value > most) {
            throw new IllegalArgumentException(key + " must be " + least + " to " + most + ", not " + text);
        }
        return value;
    }
}
