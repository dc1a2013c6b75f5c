package com.zor.android.visualeffect.tidemark;

/**
 * The mesh that is drawn. It takes its heights from a smooth surface near those of the lattice, so that it may be finer
 * than the waves, and change without a jump.
 */
final class SurfaceMesh {
    /** An axis of the square, of which a middle part is seen. */
    static final class Axis {
        /** The vertices that what is seen takes. */
        final int first;
        final int count;

        // Where each of them lies: between the points cell and cell + 1 of those that are read, with the weights of the
        // four around it.
        private final int[] cells;
        private final float[][] weights;
        private final int from;  // of the lattice, that are read
        private final int points;

        private Axis(int points, int vertices, double share) {
            first = Math.max((int) ((vertices - 1) * (1 - share) / 2), 0);
            count = vertices - 2 * first;
            cells = new int[count];
            weights = new float[count][];
            for (int i = 0; i < count; ++i) {
                double place = (double) (first + i) * (points - 1) / (vertices - 1);
                cells[i] = Math.min((int) place, points - 2);
                float t = (float) (place - cells[i]);
                weights[i] = new float[] {(1 - t) * (1 - t) * (1 - t) / 6, ((3 * t - 6) * t * t + 4) / 6,
                    (((3 - 3 * t) * t + 3) * t + 1) / 6, t * t * t / 6};
            }
            // With the neighbours two cells before and three behind.
            from = Math.max(cells[0] - 2, 0);
            this.points = Math.min(cells[count - 1] + 4, points) - from;
            for (int i = 0; i < count; ++i) cells[i] -= from;
        }
    }

    final Axis columns;
    final Axis rows;
    private final int points;
    private final float[][] lattice;  // row by row, as it is at that time
    private final float[] ownRow;  // the lattice's columns at a row of the mesh
    private final float[] upperRow;  // and one cell above it
    private final float[][] own;  // of all rows, column by column
    private final float[][] upper;
    private final float[] heights;  // a column of the mesh
    private final float[] rights;
    private final float[] uppers;
    private float[] slopes;  // the products of both slopes in this column
    private float[] slopesBefore;  // and in the one before

    /**
     * A square of {@code vertices} a side over a lattice of {@code points} a side, each at least 2, of which only a
     * middle part is seen: {@code width} and {@code height} are its shares of a side, above 0.
     */
    SurfaceMesh(int points, int vertices, double width, double height) {
        this.points = points;
        columns = new Axis(points, vertices, width);
        rows = new Axis(points, vertices, height);
        lattice = new float[rows.points][columns.points];
        ownRow = new float[columns.points];
        upperRow = new float[columns.points];
        own = new float[columns.points][rows.count];
        upper = new float[columns.points][rows.count];
        heights = new float[rows.count];
        rights = new float[rows.count];
        uppers = new float[rows.count];
        slopes = new float[rows.count];
        slopesBefore = new float[rows.count];
    }

    /** The two triangles of each cell that is seen, column by column. */
    short[] layCells() {
        short[] indices = new short[6 * (columns.count - 1) * (rows.count - 1)];
        int i = 0;
        for (int c = 0; c < columns.count - 1; ++c) {
            for (int r = 0; r < rows.count - 1; ++r) {
                int topLeft = c * rows.count + r;
                int topRight = topLeft + rows.count;
                for (int corner : new int[] {topLeft, topLeft + 1, topRight + 1, topLeft, topRight + 1, topRight}) {
                    indices[i++] = (short) corner;
                }
            }
        }
        return indices;
    }

    /**
     * For each vertex that is seen, column by column from the left and each column from the top: its height, and the
     * heights one cell of the lattice to the right and above, of which the renderer takes the slope. Beyond the edge the
     * surface goes on level. A bicubic B-spline (de Boor, A practical guide to splines, 1978): its slopes bend smoothly,
     * where a surface through the very heights would show the lattice in every crest.
     *
     * <p>Also turns the diagonal of each cell along its waves, as one across would cut a crest into teeth. Which way they
     * run is the sign of the mixed element of the structure tensor (Bigun and Granlund, Optimal orientation detection of
     * linear symmetry, 1987).
     *
     * @param waves points * points heights in the same order
     * @param velocity what each of them gains a step
     * @param since steps passed since then
     * @param attribs receives 3 values a vertex
     * @param indices as laid by {@link #layCells}
     */
    void gather(float[] waves, float[] velocity, float since, float[] attribs, short[] indices) {
        for (int c = 0; c < columns.points; ++c) {
            int line = (columns.from + c) * points + rows.from;
            for (int r = 0; r < rows.points; ++r) lattice[r][c] = waves[line + r] + since * velocity[line + r];
        }
        for (int r = 0; r < rows.count; ++r) {
            blend(lattice, rows.cells[r], rows.weights[r], ownRow);
            blend(lattice, rows.cells[r] - 1, rows.weights[r], upperRow);
            for (int c = 0; c < columns.points; ++c) {
                own[c][r] = ownRow[c];
                upper[c][r] = upperRow[c];
            }
        }
        for (int c = 0, out = 0; c < columns.count; ++c) {
            blend(own, columns.cells[c], columns.weights[c], heights);
            blend(own, columns.cells[c] + 1, columns.weights[c], rights);
            blend(upper, columns.cells[c], columns.weights[c], uppers);
            for (int r = 0; r < rows.count; ++r, out += 3) {
                attribs[out] = heights[r];
                attribs[out + 1] = rights[r];
                attribs[out + 2] = uppers[r];
            }
            turnDiagonals(c, indices);
        }
    }

    // Chooses the diagonals of the cells that end at a column of the mesh.
    private void turnDiagonals(int column, short[] indices) {
        float[] left = slopes;
        float[] right = slopesBefore;
        slopes = right;
        slopesBefore = left;
        for (int r = 0; r < right.length; ++r) right[r] = (heights[r] - rights[r]) * (heights[r] - uppers[r]);
        if (column == 0) return;
        int cells = rows.count - 1;
        int cell = 6 * (column - 1) * cells;
        int topRight = column * rows.count;
        for (int r = 0; r < cells; ++r, ++topRight, cell += 6) {
            int turned = Float.floatToRawIntBits(left[r] + left[r + 1] + right[r] + right[r + 1]) >>> 31;
            indices[cell + 2] = (short) (topRight + 1 - turned);
            indices[cell + 3] = (short) (topRight - rows.count + turned);
        }
    }

    // One line of values between the lines cell and cell + 1; beyond the edge the last line goes on.
    private static void blend(float[][] lines, int cell, float[] weights, float[] out) {
        float[] a = line(lines, cell - 1);
        float[] b = line(lines, cell);
        float[] c = line(lines, cell + 1);
        float[] d = line(lines, cell + 2);
        float wa = weights[0];
        float wb = weights[1];
        float wc = weights[2];
        float wd = weights[3];
        for (int i = 0; i < out.length; ++i) out[i] = wa * a[i] + wb * b[i] + wc * c[i] + wd * d[i];
    }

    private static float[] line(float[][] lines, int i) {
        return lines[Math.max(0, Math.min(i, lines.length - 1))];
    }
}
