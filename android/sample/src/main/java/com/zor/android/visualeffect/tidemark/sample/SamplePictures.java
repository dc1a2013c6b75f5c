package com.zor.android.visualeffect.tidemark.sample;

import android.graphics.Bitmap;

/** What the sample shows before the user picks a picture. */
final class SamplePictures {
    private SamplePictures() {}

    /** Ribbed sand, from shallow at the top to deep at the bottom. */
    static Bitmap sand(int width, int height) {
        int[] colors = new int[width * height];
        double cycle = 2 * Math.PI / (0.06 * Math.max(width, height));
        for (int y = 0, i = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x, ++i) {
                double bend = 1.5 * Math.sin(x * cycle * 0.31) + 0.8 * Math.sin((x + y) * cycle * 0.17);
                double rib = 0.5 + 0.5 * Math.sin(y * cycle + bend);
                double light = 1 - 0.35 * y / height;
                colors[i] = rgb((150 + 60 * rib) * light, (150 + 45 * rib) * light, (120 + 30 * rib) * light + 20);
            }
        }
        return Bitmap.createBitmap(colors, width, height, Bitmap.Config.ARGB_8888);
    }

    /** A net of light, as the sun draws it on the ground of a pool. */
    static Bitmap light(int side) {
        int[] colors = new int[side * side];
        double turn = 2 * Math.PI / side;
        for (int y = 0, i = 0; y < side; ++y) {
            for (int x = 0; x < side; ++x, ++i) {
                double u = 3 * x * turn + Math.sin(2 * y * turn);
                double v = 3 * y * turn + Math.sin(2 * x * turn + 1);
                double net = 1 - 0.5 * Math.abs(Math.sin(u) + Math.sin(v));
                double bright = 255 * Math.pow(net, 4);
                colors[i] = rgb(0.85 * bright, 0.95 * bright, bright);
            }
        }
        return Bitmap.createBitmap(colors, side, side, Bitmap.Config.ARGB_8888);
    }

    private static int rgb(double red, double green, double blue) {
        return 0xff000000 | (int) red << 16 | (int) green << 8 | (int) blue;
    }
}
