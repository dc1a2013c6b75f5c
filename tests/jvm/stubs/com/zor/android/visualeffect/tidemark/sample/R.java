package com.zor.android.visualeffect.tidemark.sample;

/** What the build tools make of the sample's resources. */
final class R {
    static final class id {
        static final int clear = 1;
        static final int ink = 2;
        static final int picture = 3;
        static final int rain = 4;
        static final int water = 5;
    }

    static final class layout {
        static final int main = 6;
    }

    static final class string {
        static final int unreadable = 7;
    }
}
