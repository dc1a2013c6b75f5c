package com.zor.android.visualeffect.tidemark;

/**
 * The mesh that is drawn. It takes its heights from a smooth surface near those of the lattice, so that it may be finer
 * than the waves, and change without a jump.
 */
final class SurfaceMesh {
    private final int points;
    private final int vertices;

    // Where a vertex lies along an axis: between the points cell and cell + 1, with the weights of the four around it.
    private final int[] cells;
    private final float[][] weights;

    private final float[] column;  // of the lattice, with two points more at either end
    private final float[][] own;  // the lattice's columns at the mesh's rows
    private final float[][] upper;  // one cell above them

    /** {@code vertices} a side, over a lattice of {@code points} a side; each at least 2. */
    SurfaceMesh(int points, int vertices) {
        this.points = points;
        this.vertices = vertices;
        cells = new int[vertices];
        weights = new float[vertices][];
        column = new float[points + 4];
        own = new float[points][vertices];
        upper = new float[points][vertices];
        for (int i = 0; i < vertices; ++i) {
            double place = (double) i * (points - 1) / (vertices - 1);
            cells[i] = Math.min((int) place, points - 2);
            float t = (float) (place - cells[i]);
            weights[i] = new float[] {(1 - t) * (1 - t) * (1 - t) / 6, ((3 * t - 6) * t * t + 4) / 6,
                (((3 - 3 * t) * t + 3) * t + 1) / 6, t * t * t / 6};
        }
    }

    /**
     * For each vertex, column by column from the left and each column from the top: its height, and the heights one cell
     * of the lattice to the right and above, of which the renderer takes the slope. Beyond the edge the surface goes on
     * level. A bicubic B-spline (de Boor, A practical guide to splines, 1978): its slopes bend smoothly, where a surface
     * through the very heights would show the lattice in every crest.
     *
     * @param heights points * points values in the same order
     * @param attribs receives 3 * vertices * vertices
     */
    void gather(float[] heights, float[] attribs) {
        for (int c = 0; c < points; ++c) {
            System.arraycopy(heights, c * points, column, 2, points);
            column[0] = column[1] = column[2];
            column[points + 2] = column[points + 3] = column[points + 1];
            for (int r = 0; r < vertices; ++r) {
                float[] w = weights[r];
                int h = cells[r];
                own[c][r] = w[0] * column[h + 1] + w[1] * column[h + 2] + w[2] * column[h + 3] + w[3] * column[h + 4];
                upper[c][r] = w[0] * column[h] + w[1] * column[h + 1] + w[2] * column[h + 2] + w[3] * column[h + 3];
            }
        }
        for (int c = 0; c < vertices; ++c) {
            int first = 3 * c * vertices;
            blend(own, c, 0, attribs, first);
            blend(own, c, 1, attribs, first + 1);
            blend(upper, c, 0, attribs, first + 2);
        }
    }

    // One column of the mesh from four of the lattice, into every third float.
    private void blend(float[][] of, int vertex, int shift, float[] attribs, int first) {
        int cell = cells[vertex] + shift;
        float[] w = weights[vertex];
        float w0 = w[0];
        float w1 = w[1];
        float w2 = w[2];
        float w3 = w[3];
        float[] a = of[within(cell - 1)];
        float[] b = of[within(cell)];
        float[] c = of[within(cell + 1)];
        float[] d = of[within(cell + 2)];
        for (int r = 0, out = first; r < vertices; ++r, out += 3) {
            attribs[out] = w0 * a[r] + w1 * b[r] + w2 * c[r] + w3 * d[r];
        }
    }

    private int within(int column) {
        return Math.max(0, Math.min(column, points - 1));
    }
}
