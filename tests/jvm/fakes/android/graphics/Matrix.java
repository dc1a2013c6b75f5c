package android.graphics;

/** A matrix of right angles and mirrors. */
public class Matrix {
    int xx = 1, xy, yx, yy = 1;

    /** Rotates clockwise, as y is the distance from the top. */
    public boolean postRotate(float degrees) {
        for (; degrees > 0; degrees -= 90) {
            int oldXx = xx, oldXy = xy;
            xx = -yx;
            xy = -yy;
            yx = oldXx;
            yy = oldXy;
        }
        return true;
    }

    public boolean postScale(float x, float y) {
        xx *= (int) x;
        xy *= (int) x;
        yx *= (int) y;
        yy *= (int) y;
        return true;
    }

    int[] map(int x, int y) {
        return new int[] {xx * x + xy * y, yx * x + yy * y};
    }
}
