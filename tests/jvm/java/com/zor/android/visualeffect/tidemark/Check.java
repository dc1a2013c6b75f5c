package com.zor.android.visualeffect.tidemark;

import java.util.Objects;

public final class Check {
    private Check() {}

    public static void that(boolean holds, String what) {
        if (!holds) throw new AssertionError(what);
    }

    public static void equal(Object expected, Object actual, String what) {
        that(Objects.equals(expected, actual), what + ": expected " + expected + ", not " + actual);
    }
}
