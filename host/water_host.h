// The part of an app that calls the library in the required order. It owns the mesh arrays, the view, the transform and
// the lighting values, turns touches and rain into ripples, steps water and ink in time, and tells whether there is
// anything new to draw. LiveWater drives it for a screen; a renderer of videos may drive it directly.
//
// Call everything on the thread that owns the OpenGL ES 2.0 context.
#pragma once

#include <cstdint>
#include <functional>
#include <random>
#include <vector>

#include "host/breeze.h"
#include "host/host_jni.h"
#include "host/look.h"
#include "host/picture_source.h"
#include "host/stroke_clock.h"
#include "host/surface_mesh.h"
#include "host/wave_lattice.h"

namespace tidemark {

class WaterHost {
public:
    // `seed` determines the rain. The view is width x height pixels, each at least 1. All values of the look are within
    // their limits, see look_values.h.
    WaterHost(const Look& look, int width, int height, std::uint32_t seed);

    // Changes the size of the view. Call setUp next. The water is kept, the ink is lost.
    void resize(int width, int height);

    // Returns the ratio of the shorter to the longer side to which the backgrounds must be cropped.
    double proportions() const;

    // Sets the library up in the current context, with or without ink. Ink that was there is lost.
    void setUp(bool withInk);

    // Requests the pictures `due` from the source, then uploads these and the pictures `which`, which the library
    // already has.
    void loadPictures(const PictureSource& pictures, unsigned due = kAllPictures, unsigned which = kAllPictures);

    // Sets all values of the look, which must be within their limits. Water and ink are kept.
    void setLook(const Look& look);
    const Look& look() const { return look_; }

    // Reduces the number of vertices along each side to this share of the number that the view's size requires. Ignored
    // if the look sets meshVertices.
    void setMeshShare(double share);

    // Requests a frame after the framebuffer has lost the last one. It does not wait for an ink step.
    void redraw() { changed_ = isLost_ = true; }

    // Returns the sum of the seconds passed to advance(), the clock for the times of touches.
    double time() const { return time_; }

    // Before the first setUp, touch, splash, advance and clearInk do nothing.

    // Adds a touch at x, y pixels from the top left of the view. A stroke begins with down. Ripples follow immediately,
    // the ink shortly after `time`. `weight` is 1 for a finger and 0.3 to 1.5 for a pen.
    void touch(TouchAction action, double x, double y, float weight, double time);
    void touch(TouchAction action, double x, double y, float weight) { touch(action, x, y, weight, time_); }

    // Returns whether a finger is down.
    bool isTouched() const { return fingerDown_; }

    // Raises the same ripple as a touch of this weight, without ink.
    void splash(double x, double y, float weight);

    // Turns rain on or off; it falls at `look.rainDropsPerSecond`.
    void rain(bool falling) { raining_ = falling; }

    // If true, the breeze never ends. Otherwise it fades some seconds after the last ripple.
    void blowAlways(bool always) { blowsAlways_ = always; }

    // Advances the water by `seconds`. Returns whether a frame is due: while there is ink, when one of its steps is
    // due, because each frame steps the ink; otherwise when the picture has changed since the last draw.
    bool advance(double seconds);

    // Returns when advance() will next return true, on the clock of time(). Requires isResting() to be false.
    double due() const;

    // Returns whether the picture stays the same until the next call that changes something.
    bool isResting() const;

    // Returns whether there is ink. Each of its steps needs a frame, so at most look.inkStepsPerSecond frames a second
    // are drawn.
    bool inkMoves() const { return withInk_ && inkStart_ < 0.0 && (strokes_.isActive() || inkSteps_ > 0); }

    // Draws a frame: without ink into the current framebuffer, with ink into framebuffer 0. With ink, also runs the
    // steps that are due, at least one and at most four; more are skipped, so that one late frame does not delay the
    // next. The steps left when `isEnough` returns true are skipped, too.
    void draw(const std::function<bool()>& isEnough = {});

    // Removes all ink with the next frame.
    void clearInk();

    // Returns the heights of the lattice, column by column from the left, each column from the top.
    const std::vector<float>& heights() const { return heights_.values; }
    const WaveLattice& lattice() const { return lattice_; }

private:
    // A ripple that is being raised over several steps. Raised in one step it would look like a facetted cone for some
    // frames.
    struct Drop {
        float x, y;  // model units
        float amplitude;
        float rebound;
        int step;
    };

    struct Place {
        float x, y;
    };
    Place modelPlace(double x, double y) const;

    void fit();
    int wantedVertices() const;
    void makeMesh(int vertices);
    void fillMesh();
    void raiseTouchRipples(TouchAction action, Place place, float amplitude);
    void raise(Place place, float amplitude, float rebound);
    void stepWater();
    void growDrops();
    void addRipple(const Drop& drop, float share);
    void dropRain();
    bool isBreezy() const { return isSetUp_ && look_.breeze > 0.0f && (gust_ > 0.0 || isStirred()); }
    bool isStirred() const { return blowsAlways_ || time_ < calmAt_; }
    void breathe(double seconds);
    double inkStep() const { return 1.0 / look_.inkStepsPerSecond; }
    bool isStill() const {
        return !changed_ && !raining_ && drops_.empty() && !isBreezy() && calmSteps_ >= look_.stepsToRest;
    }
    void startInk();
    void gatherHeights();
    void drawOnce(bool isSeen);

    Look look_;
    int width_ = 0;  // size of the view in pixels
    int height_ = 0;
    std::minstd_rand random_;
    bool raining_ = false;
    bool withInk_ = false;
    bool isSetUp_ = false;
    bool changed_ = true;  // since the last draw
    bool isLost_ = false;  // the framebuffer has lost the last frame
    double time_ = 0.0;

    int calmSteps_;          // calm steps in a row
    double dueSteps_ = 0.0;  // water steps that are due; negative if the water is ahead
    std::vector<Drop> drops_;
    bool fingerDown_ = false;
    Place trail_ = {};  // position of the finger's last ripple

    Breeze breeze_;
    bool blowsAlways_ = false;
    double calmAt_ = 0.0;  // when the breeze begins to fade
    double gust_ = 0.0;    // strength of the breeze, 0 to 1, before smoothing

    StrokeClock strokes_;
    double inkStart_ = -1.0;  // when the ink starts after a rest; negative if not set
    double inkTime_ = 0.0;    // time of the ink's last step
    int inkSteps_ = 0;        // until the ink has faded: the library does not tell whether any remains

    bool isGathered_ = false;  // the mesh has exactly the lattice's heights
    bool isMeshFilled_ = false;

    // The part of the square mesh that the view shows, in model units, and the integer extent of the picture that the
    // library receives.
    float visibleWidth_ = 0.0f;
    float visibleHeight_ = 0.0f;
    int pictureWidth_ = 0;
    int pictureHeight_ = 0;

    WaveLattice lattice_;
    FloatArray velocity_{0};
    FloatArray heights_{0};

    double meshShare_ = 1.0;
    SurfaceMesh mesh_{2, 2, 1.0, 1.0};
    int vertices_ = 0;  // along each side of the square mesh
    FloatArray positions_{0};
    ShortArray indices_{0};
    FloatArray heightAttribs_{0};
    FloatArray mvp_{16};
};

}  // namespace tidemark
