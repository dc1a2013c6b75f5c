package com.zor.android.visualeffect.tidemark;

import java.util.Arrays;

/**
 * What an app does around the library: owns the mesh arrays, the view, the transform and the lighting values, turns
 * touches and rain into ripples, steps the water at a fixed rate and tells when there is nothing new to draw.
 *
 * <p>Call everything on the one thread that owns the OpenGL ES 2.0 context. It needs nothing of Android, and draws the
 * same pictures as the host in C++ with the same calls: keep every sum in its order and in its precision.
 */
public final class WaterHost {
    /** The action codes of {@code android.view.MotionEvent}. */
    public static final int DOWN = 0;
    public static final int UP = 1;
    public static final int MOVE = 2;
    public static final int CANCEL = 3;

    private final JniTidemarkRender library;
    private Look look;
    private final RainChance chance;

    private int width;
    private int height;
    private boolean raining;
    private boolean withInk;
    private boolean isSetUp;
    private boolean fingerDown;
    private int inkFrames;  // until the ink has faded: the library does not tell whether any is left
    private boolean changed = true;  // since the last draw
    private int calmSteps;  // in a row
    private double dueSteps;  // that the time passed so far still asks for
    private float touchX;  // where the finger raised its last ripple, model units
    private float touchY;

    // The part of the square mesh that the view shows, in model units, and the whole numbers at or above it, which
    // the library takes for the picture's extent.
    private float visibleWidth;
    private float visibleHeight;
    private int pictureWidth;
    private int pictureHeight;

    private final float[] positions;
    private final short[] indices;
    private final float[] velocity;
    private final float[] heights;
    private final float[] heightAttribs;
    private final float[] mvp = new float[16];

    /** {@code seed} fixes where the rain falls. The view is width x height pixels, each at least 1. */
    public WaterHost(JniTidemarkRender library, Look look, int width, int height, int seed) {
        this.library = library;
        this.look = look.clone();
        chance = new RainChance(seed);
        calmSteps = look.stepsToRest;
        int vertices = look.meshVertices * look.meshVertices;
        int cells = (look.meshVertices - 1) * (look.meshVertices - 1);
        positions = new float[3 * vertices];
        indices = new short[6 * cells];
        velocity = new float[vertices];
        heights = new float[vertices];
        heightAttribs = new float[3 * vertices];
        resize(width, height);
    }

    /**
     * {@link #setUp} must follow, and before it another hand-over of the backgrounds where the proportions have changed.
     */
    public void resize(int width, int height) {
        this.width = width;
        this.height = height;
        // The mesh is a square around the view, so that its cells are squares on the screen and rings stay round. The
        // view shows the middle of it.
        float pixel = look.meshExtent / look.pictureZoom / Math.max(width, height);
        visibleWidth = pixel * width;
        visibleHeight = pixel * height;
        pictureWidth = (int) Math.ceil(visibleWidth);
        pictureHeight = (int) Math.ceil(visibleHeight);
        Arrays.fill(mvp, 0);
        mvp[0] = 2 / visibleWidth;
        mvp[5] = 2 / visibleHeight;
        mvp[10] = 1;
        mvp[15] = 1;
        changed = true;
    }

    /** Shorter by longer side of what the backgrounds are cropped to in portrait and in landscape. */
    public double proportions() {
        return (double) Math.min(pictureWidth, pictureHeight) / Math.max(pictureWidth, pictureHeight);
    }

    /**
     * Hands pictures over, of which the library keeps copies; before {@link #setUp} or {@link #loadTextures}.
     *
     * @param which a sum of {@link Pictures}' numbers
     */
    public void handOver(Pictures pictures, int which) {
        pictures.handOver(library, which, Math.min(pictureWidth, pictureHeight), Math.max(pictureWidth, pictureHeight));
    }

    /**
     * Sets the library up in the current context, with or without ink. A new context needs all textures; one that goes
     * on, with another size or mode, keeps those that it has.
     */
    public void setUp(boolean withInk, int textures) {
        library.onInitSetting(width, height, withInk);
        library.onInitGPU();
        // The library would keep a stroke that the switch interrupts and go on with it at the next touch.
        if (withInk != this.withInk) library.clearInkValue();
        this.withInk = withInk;
        inkFrames = 0;
        loadTextures(textures);
        if (!isSetUp) {
            library.initWaters(positions, indices, look.meshVertices * look.meshVertices, look.meshExtent,
                    look.meshExtent, look.meshVertices, look.meshVertices);
        }
        isSetUp = true;
        changed = true;
    }

    /** Shows pictures handed over since {@link #setUp}; the water and the ink stay as they are. */
    public void loadTextures(int which) {
        if ((which & Pictures.PORTRAIT) != 0) library.onLoadPortraitBGTextures();
        if ((which & Pictures.LANDSCAPE) != 0) library.onLoadLandscapeBGTextures();
        if ((which & Pictures.WATER) != 0) library.onLoadWaterTextures();
        changed |= which != 0;
    }

    /** Takes over all values but those of the mesh, which must be the same. */
    public void setLook(Look look) {
        this.look = look.clone();
        changed = true;
    }

    /** Where the framebuffer has lost the last frame. */
    public void redraw() {
        changed = true;
    }

    /**
     * One touch event: pixels from the top left corner of the view, one of the actions above, pressure around 1. A
     * stroke begins with the finger's coming down. This, {@link #advance} and {@link #clearInk} do nothing before the
     * first {@link #setUp}.
     */
    public void touch(int action, int x, int y, float pressure) {
        if (!isSetUp) return;
        raiseTouchRipples(action, x, y, look.touchAmplitude * pressure);
        fingerDown = action == DOWN || action == MOVE && fingerDown;
        if (!withInk) return;
        library.onTouch(x, y, action, pressure);
        inkFrames = look.framesToFade;
    }

    /** Raises the ripple of a finger of this pressure that comes down, without a finger and without ink. */
    public void splash(int x, int y, float pressure) {
        if (!isSetUp) return;
        float modelX = ((float) x / width - 0.5f) * visibleWidth;
        float modelY = (0.5f - (float) y / height) * visibleHeight;
        raiseRipple(modelX, modelY, look.touchAmplitude * pressure);
    }

    /** Lets rain fall, {@code look.rainDropsPerSecond} drops a second, until it is switched off. */
    public void rain(boolean falling) {
        raining = falling;
    }

    /** Lets all ink vanish with the next frame. */
    public void clearInk() {
        if (!isSetUp) return;
        library.clearInkValue();
        changed = true;
    }

    /** Advances the water by {@code seconds} and says whether the picture has changed since the last draw. */
    public boolean advance(double seconds) {
        if (!isSetUp) return false;
        dueSteps += Math.min(seconds, look.longestFrame) * look.stepsPerSecond;
        // The small extra lets a frame of exactly one step's length bring its step in spite of rounding.
        for (; dueSteps > 1 - 1.0e-6; dueSteps -= 1) {
            if (raining) dropRain();
            if (calmSteps < look.stepsToRest) stepWater();
        }
        return changed || inkMoves();
    }

    /** Whether the picture stays as it is, however much time passes, until the next call that changes something. */
    public boolean isResting() {
        return !changed && !raining && calmSteps >= look.stepsToRest && !inkMoves();
    }

    /**
     * Draws one frame: without ink into the current framebuffer, with ink into framebuffer 0. With ink, this is also one
     * step of the ink.
     */
    public void draw() {
        gatherHeights();
        library.onDrawFrame(positions, heightAttribs, indices, positions.length, heightAttribs.length, indices.length,
                mvp, pictureWidth, pictureHeight, look.meshVertices, look.meshVertices, look.refractiveIndex,
                look.alphaMix, look.alphaScale1, look.alphaScale2, look.inkRed, look.inkGreen, look.inkBlue,
                look.fresnelRatio, look.specularRatio, look.exponent, width > height);
        changed = false;
        if (inkFrames > 0) --inkFrames;
    }

    private boolean inkMoves() {
        return withInk && fingerDown || inkFrames > 0;
    }

    private void raiseTouchRipples(int action, int x, int y, float amplitude) {
        float modelX = ((float) x / width - 0.5f) * visibleWidth;
        float modelY = (0.5f - (float) y / height) * visibleHeight;
        if (action == DOWN) {
            raiseRipple(modelX, modelY, amplitude);
        } else if (action == MOVE && fingerDown) {
            float spacing = look.trailCells * look.meshExtent / (look.meshVertices - 1);
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
        int n = look.meshVertices;
        boolean calm = library.move(velocity, heights, 1, 1, n - 1, n - 1, n, n, true, look.damping, look.waveSpeed);
        calmSteps = calm ? calmSteps + 1 : 0;
        changed = true;
    }

    private void dropRain() {
        if (chance.draw() * look.stepsPerSecond >= look.rainDropsPerSecond) return;
        float x = (chance.draw() - 0.5f) * visibleWidth;
        float y = (chance.draw() - 0.5f) * visibleHeight;
        raiseRipple(x, y, look.rainAmplitude * (0.5f + 0.5f * chance.draw()));
    }

    /** Position in model units. */
    private void raiseRipple(float x, float y, float amplitude) {
        // The library counts countA cells across the extent, the mesh has one interval less; these positions hit the
        // very vertex. The fast axis runs down a column of the mesh.
        float extent = look.meshExtent;
        float n = look.meshVertices;
        float row = (0.5f - y / extent) * (n - 1);
        float column = (0.5f + x / extent) * (n - 1);
        library.ripple(heights, look.meshExtent, look.meshExtent, look.meshVertices, look.meshVertices,
                (row / n - 0.5f) * extent, (column / n - 0.5f) * extent, amplitude);
        calmSteps = 0;
    }

    // Each vertex gets its own height and those of its right-hand and upper neighbours; vertices are stored column by
    // column from the left, each column from the top. The last ones of their kind repeat their own height.
    private void gatherHeights() {
        int n = look.meshVertices;
        float[] h = heights;
        for (int column = 0, i = 0, out = 0; column < n; ++column) {
            for (int row = 0; row < n; ++row, ++i) {
                heightAttribs[out++] = h[i];
                heightAttribs[out++] = column < n - 1 ? h[i + n] : h[i];
                heightAttribs[out++] = row > 0 ? h[i - 1] : h[i];
            }
        }
    }
}
