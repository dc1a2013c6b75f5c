package com.zor.android.visualeffect.tidemark;

import org.jetbrains.annotations.NotNull;

/**
 * What an app does around the library: owns the mesh arrays, the view, the transform and the lighting values, turns
 * touches and rain into ripples, steps water and ink in time and tells when there is nothing new to draw.
 *
 * <p>Call everything on the one thread that owns the OpenGL ES 2.0 context. It needs nothing of Android, and draws the
 * same pictures as the host in C++ with the same calls: keep every sum in its order and in its precision.
 */
public final class WaterHost {
    /** This and those below: the action codes of {@code android.view.MotionEvent}. */
    public static final int DOWN = 0;
    /** The finger leaves. */
    public static final int UP = 1;
    /** It has moved. */
    public static final int MOVE = 2;
    /** It is somebody else's from now on. */
    public static final int CANCEL = 3;

    private static final double INK_STEPS_PER_SECOND = 60;
    private static final int MOST_INK_STEPS = 4;

    // Nearer to a step than this, in steps, the heights are those of the step.
    private static final float AT_STEP = 0.0625f;

    // The peak of a ripple is three times as high, and the water keeps heights of up to 100.
    private static final float MOST_AMPLITUDE = 100.0f / 3.0f;

    private final JniTidemarkRender library;
    private Look look;
    private final RainChance chance;

    private int width;
    private int height;
    private boolean raining;
    private boolean withInk;
    private boolean isSetUp;
    private boolean fingerDown;
    private int inkSteps;  // until the ink has faded: the library does not tell whether any is left
    private boolean changed = true;  // since the last draw
    private int calmSteps;  // in a row
    private double dueSteps;  // of the water that the time passed so far still asks for; below 0 when it is ahead
    private double dueInkSteps;
    private boolean isGathered;  // the mesh has the heights of the lattice
    private boolean isMeshFilled;
    private float touchX;  // where the finger raised its last ripple, model units
    private float touchY;

    // The part of the square mesh that the view shows, in model units, and the whole numbers at or above it, which
    // the library takes for the picture's extent.
    private float visibleWidth;
    private float visibleHeight;
    private int pictureWidth;
    private int pictureHeight;

    private WaveLattice lattice;
    private float[] velocity = {};
    private float[] heights = {};

    private final MeshQuality quality = new MeshQuality();
    private SurfaceMesh mesh;
    private int vertices;  // of the mesh, along each side of the square
    private float[] positions;
    private short[] indices;
    private float[] heightAttribs;
    private final float[] mvp = new float[16];

    /**
     * Flat water that is not set up.
     *
     * @param library whose calls it makes
     * @param look is copied
     * @param width of the view in pixels, at least 1
     * @param height likewise
     * @param seed fixes where the rain falls
     */
    public WaterHost(@NotNull JniTidemarkRender library, @NotNull Look look, int width, int height, int seed) {
        this.library = library;
        this.look = look.withinLimits();
        chance = new RainChance(seed);
        calmSteps = this.look.stepsToRest;
        resize(width, height);
    }

    /**
     * {@link #setUp} must follow, and before it another hand-over of the backgrounds where the proportions have changed.
     * The water stays.
     *
     * @param width of the view in pixels, at least 1
     * @param height likewise
     */
    public void resize(int width, int height) {
        this.width = width;
        this.height = height;
        quality.fitTo(width, height, look.pictureZoom);
        fit();
    }

    /**
     * Takes over all values, brought within their limits; the water and the ink stay.
     *
     * @param look is copied
     */
    public void setLook(@NotNull Look look) {
        this.look = look.withinLimits();
        fit();
    }

    /**
     * Where the look leaves the mesh to the host, it gets coarser when frames take long.
     *
     * @param seconds that the processor spent on a frame
     */
    public void noteWork(double seconds) {
        quality.noteWork(seconds);
        if (wantedVertices() != vertices) fit();
    }

    private int wantedVertices() {
        return look.meshVertices > 1 ? look.meshVertices : quality.vertices();
    }

    // Lays the lattice and the mesh, squares around the view, so that their cells are squares on the screen and rings stay
    // round. The view shows the middle of them.
    private void fit() {
        int oldPoints = lattice == null ? 0 : lattice.points;
        int oldExtent = lattice == null ? 0 : lattice.extent;
        lattice = new WaveLattice(look, width, height);
        if (lattice.points != oldPoints) {
            velocity = resampled(velocity, oldPoints, lattice.points);
            heights = resampled(heights, oldPoints, lattice.points);
        }
        float oldWidth = visibleWidth;
        float oldHeight = visibleHeight;
        float pixel = lattice.extent / look.pictureZoom / Math.max(width, height);
        visibleWidth = pixel * width;
        visibleHeight = pixel * height;
        int wanted = wantedVertices();
        if (lattice.points != oldPoints || lattice.extent != oldExtent || wanted != vertices || visibleWidth != oldWidth
                || visibleHeight != oldHeight) {
            makeMesh(wanted);
        }
        pictureWidth = (int) Math.ceil(visibleWidth);
        pictureHeight = (int) Math.ceil(visibleHeight);
        mvp[0] = 2 / visibleWidth;
        mvp[5] = 2 / visibleHeight;
        mvp[10] = 1;
        mvp[15] = 1;
        changed = true;
    }

    private void makeMesh(int side) {
        vertices = side;
        mesh = new SurfaceMesh(lattice.points, side, (double) visibleWidth / lattice.extent,
                (double) visibleHeight / lattice.extent);
        isGathered = false;
        isMeshFilled = false;
    }

    // Takes from the library's square what the view shows, with cells whose diagonals can be turned.
    private void fillMesh() {
        float[] allPositions = new float[3 * vertices * vertices];
        short[] allIndices = new short[6 * (vertices - 1) * (vertices - 1)];
        library.initWaters(allPositions, allIndices, vertices * vertices, lattice.extent, lattice.extent, vertices,
                vertices);
        int firstColumn = mesh.columns.first;
        int columns = mesh.columns.count;
        int firstRow = mesh.rows.first;
        int rows = mesh.rows.count;
        positions = new float[3 * columns * rows];
        heightAttribs = new float[positions.length];
        for (int c = 0; c < columns; ++c) {
            System.arraycopy(allPositions, 3 * ((firstColumn + c) * vertices + firstRow), positions, 3 * c * rows,
                    3 * rows);
        }
        indices = mesh.layCells();
        isMeshFilled = true;
    }

    // A field on a lattice of another size, by its nearest values.
    private static float[] resampled(float[] field, int from, int to) {
        float[] result = new float[to * to];
        for (int c = 0; c < to && from > 1; ++c) {
            int column = (2 * c * (from - 1) + to - 1) / (2 * (to - 1));
            for (int r = 0; r < to; ++r) {
                int row = (2 * r * (from - 1) + to - 1) / (2 * (to - 1));
                result[c * to + r] = field[column * from + row];
            }
        }
        return result;
    }

    /**
     * Of what the backgrounds are cropped to in portrait and in landscape.
     *
     * @return shorter by longer side
     */
    public double proportions() {
        return (double) Math.min(pictureWidth, pictureHeight) / Math.max(pictureWidth, pictureHeight);
    }

    /**
     * Hands pictures over, of which the library keeps copies; before {@link #setUp} or {@link #loadTextures}.
     *
     * @param pictures with the bitmaps
     * @param which a sum of {@link Pictures}' numbers
     */
    public void handOver(@NotNull Pictures pictures, int which) {
        pictures.handOver(library, which, Math.min(pictureWidth, pictureHeight), Math.max(pictureWidth, pictureHeight));
    }

    /**
     * Sets the library up in the current context, with or without ink. A new context needs all textures; one that goes
     * on, with another size or mode, keeps those that it has.
     *
     * @param withInk whether touches drop ink
     * @param textures a sum of {@link Pictures}' numbers
     */
    public void setUp(boolean withInk, int textures) {
        library.onInitSetting(width, height, withInk);
        library.onInitGPU();
        // The library would keep a stroke that the switch interrupts and go on with it at the next touch.
        if (withInk != this.withInk) library.clearInkValue();
        this.withInk = withInk;
        inkSteps = 0;
        loadTextures(textures);
        isSetUp = true;
        changed = true;
    }

    /**
     * Shows pictures handed over since {@link #setUp}; the water and the ink stay as they are.
     *
     * @param which a sum of {@link Pictures}' numbers
     */
    public void loadTextures(int which) {
        if ((which & Pictures.PORTRAIT) != 0) library.onLoadPortraitBGTextures();
        if ((which & Pictures.LANDSCAPE) != 0) library.onLoadLandscapeBGTextures();
        if ((which & Pictures.LIGHT) != 0) library.onLoadWaterTextures();
        changed |= which != 0;
    }

    /** Where the framebuffer has lost the last frame. */
    public void redraw() {
        changed = true;
    }

    /**
     * One touch event. A stroke begins with the finger's coming down. This, {@link #advance} and {@link #clearInk} do
     * nothing before the first {@link #setUp}.
     *
     * @param action one of those above
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param pressure around 1
     */
    public void touch(int action, int x, int y, float pressure) {
        if (!isSetUp) return;
        if (!inkMoves()) dueInkSteps = 0;
        raiseTouchRipples(action, x, y, look.touchAmplitude * pressure);
        fingerDown = action == DOWN || action == MOVE && fingerDown;
        if (!withInk) return;
        library.onTouch(x, y, action, pressure);
        inkSteps = look.framesToFade;
    }

    /**
     * Raises the ripple of a finger that comes down, without a finger and without ink.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param pressure around 1
     */
    public void splash(int x, int y, float pressure) {
        if (!isSetUp) return;
        float modelX = ((float) x / width - 0.5f) * visibleWidth;
        float modelY = (0.5f - (float) y / height) * visibleHeight;
        raiseRipple(modelX, modelY, look.touchAmplitude * pressure);
    }

    /**
     * Lets rain fall, {@code look.rainDropsPerSecond} drops a second, until it is switched off.
     *
     * @param falling whether it rains
     */
    public void rain(boolean falling) {
        raining = falling;
    }

    /** Lets all ink vanish with the next frame. */
    public void clearInk() {
        if (!isSetUp) return;
        library.clearInkValue();
        changed = true;
    }

    /**
     * Lets time pass over the water.
     *
     * @param seconds since the last call
     * @return whether there is something to draw: while ink lives, when a step of it is due, as each frame moves it;
     *     otherwise when the picture has changed since the last draw
     */
    public boolean advance(double seconds) {
        if (!isSetUp) return false;
        double passed = Math.min(seconds, look.longestFrame);
        dueSteps += passed * lattice.stepsPerSecond;
        int steps = stepsIn(dueSteps);
        dueSteps -= steps;
        for (; steps > 0; --steps) {
            if (raining) dropRain();
            if (calmSteps < look.stepsToRest) stepWater();
        }
        if (calmSteps < look.stepsToRest) changed = true;
        if (!inkMoves()) return changed;
        dueInkSteps += passed * INK_STEPS_PER_SECOND;
        return dueInkSteps >= 0.5;
    }

    // Steps are taken at the time nearest to theirs, so that neither the jitter of a clock nor rounding brings none to one
    // frame and two to the next.
    private static int stepsIn(double due) {
        return Math.max((int) Math.floor(due + 0.5), 0);
    }

    /**
     * Whether time changes anything.
     *
     * @return true when the picture stays as it is, however much time passes, until the next call that changes something
     */
    public boolean isResting() {
        return !changed && !raining && calmSteps >= look.stepsToRest && !inkMoves();
    }

    /**
     * Draws a frame: without ink into the current framebuffer, with ink into framebuffer 0. With ink, moves it by the
     * steps that are due, at least by one; steps beyond the fourth are left out, so that a late frame does not make the
     * next one late.
     */
    public void draw() {
        if (!isMeshFilled) fillMesh();
        gatherHeights();
        int frames = 1;
        if (inkMoves()) {
            int steps = stepsIn(dueInkSteps);
            frames = Math.max(1, Math.min(steps, MOST_INK_STEPS));
            dueInkSteps = Math.max(-0.5, Math.min(dueInkSteps - steps, 0.5));
        }
        for (int i = 1; i <= frames; ++i) {
            // Only the last one is seen. The others move the ink below a mesh of nothing.
            int seen = i == frames ? 1 : 0;
            library.onDrawFrame(positions, heightAttribs, indices, seen * positions.length,
                    seen * heightAttribs.length, seen * indices.length, mvp, pictureWidth, pictureHeight, vertices,
                    vertices, look.refractiveIndex, look.alphaMix, look.alphaScale1, look.alphaScale2, look.inkRed,
                    look.inkGreen, look.inkBlue, look.fresnelRatio, look.specularRatio, look.exponent, width > height);
            if (inkSteps > 0) --inkSteps;
        }
        changed = false;
    }

    private boolean inkMoves() {
        return withInk && fingerDown || inkSteps > 0;
    }

    private void raiseTouchRipples(int action, int x, int y, float amplitude) {
        float modelX = ((float) x / width - 0.5f) * visibleWidth;
        float modelY = (0.5f - (float) y / height) * visibleHeight;
        if (action == DOWN) {
            raiseRipple(modelX, modelY, amplitude);
        } else if (action == MOVE && fingerDown) {
            float spacing = look.trailCells * lattice.extent / (lattice.points - 1);
            float dx = modelX - touchX;
            float dy = modelY - touchY;
            int ripples = (int) Math.min((float) Math.sqrt(dx * dx + dy * dy) / spacing, look.longestTrail);
            if (ripples < 1) return;
            for (int i = 1; i <= ripples; ++i) {
                float t = (float) i / ripples;
                raiseRipple(touchX + dx * t, touchY + dy * t, amplitude * look.trailShare);
            }
        }
        touchX = modelX;
        touchY = modelY;
    }

    private void stepWater() {
        int n = lattice.points;
        boolean calm = library.move(velocity, heights, 1, 1, n - 1, n - 1, n, n, true, lattice.damping,
                lattice.waveSpeed);
        calmSteps = calm ? calmSteps + 1 : 0;
        isGathered = false;
        changed = true;
    }

    private void dropRain() {
        if (chance.draw() * lattice.stepsPerSecond >= look.rainDropsPerSecond) return;
        float x = (chance.draw() - 0.5f) * visibleWidth;
        float y = (chance.draw() - 0.5f) * visibleHeight;
        raiseRipple(x, y, look.rainAmplitude * (0.5f + 0.5f * chance.draw()));
    }

    /** Position in model units. */
    private void raiseRipple(float x, float y, float amplitude) {
        if (Float.isNaN(amplitude) || Float.isInfinite(amplitude)) return;
        // The library counts countA cells across the extent, the lattice has one interval less; these positions hit the
        // very point. The fast axis runs down a column of the lattice.
        float extent = lattice.extent;
        float n = lattice.points;
        float row = (0.5f - y / extent) * (n - 1);
        float column = (0.5f + x / extent) * (n - 1);
        library.ripple(heights, lattice.extent, lattice.extent, lattice.points, lattice.points,
                (row / n - 0.5f) * extent, (column / n - 0.5f) * extent,
                Math.max(-MOST_AMPLITUDE, Math.min(amplitude, MOST_AMPLITUDE)));
        calmSteps = 0;
        isGathered = false;
    }

    // The heights at the time of the frame, which on a display faster than the water lies between two steps.
    private void gatherHeights() {
        boolean moves = calmSteps < look.stepsToRest;
        float since = (float) dueSteps;
        boolean atStep = !moves || Math.abs(since) < AT_STEP;
        if (atStep && isGathered) return;
        mesh.gather(heights, velocity, atStep ? 0 : since, heightAttribs, indices);
        isGathered = atStep;
    }
}
