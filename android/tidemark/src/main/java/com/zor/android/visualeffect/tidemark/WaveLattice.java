package com.zor.android.visualeffect.tidemark;

/**
 * The lattice on which the waves live. Its cells are a share of the view and its steps a share of a second, so that waves
 * look and move the same on any view, whatever mesh they are drawn with.
 */
final class WaveLattice {
    // Beyond this factor on the curvature a wave of the shortest length grows from rounding errors.
    private static final double MOST_WAVE_SPEED = 0.45;

    // The library's ripples are three cells in radius.
    private static final double RIPPLE_CELLS = 3;

    /** Along each side of a square around the view. */
    final int points;

    /** Of that side, model units. */
    final int extent;

    /** That keep the waves stable. */
    final int stepsPerSecond;

    /** A step. */
    final float damping;

    /** A step. */
    final float waveSpeed;

    /** Lengths are shares of the view's height: that of an upright view of 9 : 16 with as many pixels. */
    WaveLattice(Look look, int width, int height) {
        double longer = Math.max(width, height);
        double sides = longer / Math.sqrt((double) width * height * 16.0 / 9.0);  // in view heights
        double spanned = look.pictureZoom * sides;
        points = (int) Math.max(16, Math.min(256, Math.floor(spanned * RIPPLE_CELLS / look.dropRadius + 1.5)));
        extent = Math.max((int) Math.floor(look.meshExtent * sides + 0.5), 1);

        // Shorter steps where the waves would outrun the lattice.
        double cell = spanned / (points - 1);
        double cellsPerStep = look.ringSpeed / (cell * look.stepsPerSecond);
        double steps = Math.max(1, Math.min(8, Math.ceil(cellsPerStep / Math.sqrt(MOST_WAVE_SPEED))));
        stepsPerSecond = look.stepsPerSecond * (int) steps;
        double speed = Math.min(cellsPerStep / steps * (cellsPerStep / steps), MOST_WAVE_SPEED);

        // A wave sinks half as fast as speeds are damped, and exp(-3) is 5 %. The fraction is exp(-x) but for x^3 / 12.
        double x = 6.0 / ((double) look.calmingTime * stepsPerSecond);
        double kept = Math.max((2.0 - x) / (2.0 + x), 0);
        waveSpeed = look.waveSpeed > 0 ? look.waveSpeed : (float) speed;
        damping = look.damping > 0 ? look.damping : (float) kept;
    }
}
