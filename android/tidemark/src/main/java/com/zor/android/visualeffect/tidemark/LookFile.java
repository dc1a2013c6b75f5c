package com.zor.android.visualeffect.tidemark;

import java.io.IOException;
import java.io.InputStream;
import java.util.Properties;

/** The values of a look's file. Each is removed when it is read, so that unknown names remain. */
final class LookFile implements Look.Values {
    private static final String WHOLE = "[-+]?\\d+";
    private static final String REAL = "[-+]?(\\d+\\.?\\d*|\\.\\d+)([eE][-+]?\\d+)?";

    private final Properties unread = new Properties();

    LookFile(InputStream text) throws IOException {
        unread.load(text);
    }

    @Override
    public double next(String key, double value, double least, double most, boolean isWhole) {
        Object found = unread.remove(key);
        if (found == null) return value;
        String text = found.toString().trim();
        if (!text.matches(isWhole ? WHOLE : REAL)) {
            String kind = isWhole ? " must be a whole number, not \"" : " must be a number, not \"";
            throw new IllegalArgumentException(key + kind + text + "\"");
        }
        return Look.checked(key, Float.parseFloat(text), least, most, isWhole);
    }

    void expectAllRead() {
        for (Object key : unread.keySet()) throw new IllegalArgumentException("a look has no value \"" + key + "\"");
    }
}
