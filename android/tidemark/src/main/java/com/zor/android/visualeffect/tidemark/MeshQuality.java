package com.zor.android.visualeffect.tidemark;

/** How finely the water is drawn: cells of at most 6 pixels where the time allows. */
final class MeshQuality {
    private static final int FEWEST = 96;
    private static final int MOST = 256;  // indices have 16 bits
    private static final double CELL_PIXELS = 6;

    // A third of a frame of 60 Hz: the graphics processor and the app need theirs.
    private static final double LONGEST_WORK = 1.0 / 180;
    private static final int FRAMES_TO_JUDGE = 20;

    private int vertices = FEWEST;
    private int frames;
    private double work;  // of these frames

    /** Chosen by the size of the view, 96 to 256; again at its best for every size. */
    void fitTo(int width, int height, float pictureZoom) {
        double cells = Math.ceil(Math.max(width, height) * (double) pictureZoom / CELL_PIXELS);
        vertices = (int) Math.max(FEWEST, Math.min(MOST, cells + 1));
        frames = 0;
        work = 0;
    }

    /** What the processor spent on a frame, in seconds. Frames that take too long make the mesh coarser. */
    void noteWork(double seconds) {
        work += seconds;
        if (++frames < FRAMES_TO_JUDGE) return;
        if (work > FRAMES_TO_JUDGE * LONGEST_WORK) vertices = Math.max(vertices * 3 / 4, FEWEST);
        frames = 0;
        work = 0;
    }

    int vertices() {
        return vertices;
    }
}
