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
    public double next(String key, double usual, double least, double most, boolean isWhole) {
        Object found = left.remove(key);
        if (found == null) return usual;
        String text = found.toString().trim();
        if (!text.matches(isWhole ? WHOLE : REAL)) throw new IllegalArgumentException(key + " takes no \"" + text + "\"");
        return Look.checked(key, Float.parseFloat(text), least, most, isWhole);
    }

    void expectNoOthers() {
        for (Object key : left.keySet()) throw new IllegalArgumentException("there is no value \"" + key + "\"");
    }
}
