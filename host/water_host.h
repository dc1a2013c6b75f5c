// Does the work of an app around the library, in the order that the library requires: owns the mesh arrays, the view,
// the transform and the lighting values, turns touches and rain into ripples, steps water and ink in time and tells
// when there is nothing new to draw. LiveWater puts it on a screen; what only renders pictures may drive it directly.
//
// Call everything on the one thread that owns the OpenGL ES 2.0 context.
#pragma once

#include <cstdint>
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
    // `seed` fixes where the rain falls. The view is width x height pixels, each at least 1. Every value of the look is
    // within its limits, see look_values.h.
    WaterHost(const Look& look, int width, int height, std::uint32_t seed);

    // setUp must follow. The water stays.
    void resize(int width, int height);

    // Shorter by longer side of what the backgrounds are cropped to in portrait and in landscape.
    double proportions() const;

    // Sets the library up in the current context, with or without ink. The ink is lost.
    void setUp(bool withInk);

    // Has pictures handed over (`due`) and loads them and others that the library has already (`which`) into textures.
    void loadPictures(const PictureSource& pictures, unsigned due = kAllPictures, unsigned which = kAllPictures);

    // Takes over all values, which are within their limits; the water and the ink stay.
    void setLook(const Look& look);
    const Look& look() const { return look_; }

    // Draws with a share of the vertices along each side that the size of the view asks for, where the look leaves the
    // mesh to the host.
    void setMeshShare(double share);

    // Where the framebuffer has lost the last frame. The next one then does not wait for a step of the ink.
    void redraw() { changed_ = isLost_ = true; }

    // Seconds that have been given to advance() so far. Times of touches are measured from the same zero.
    double time() const { return time_; }

    // Before the first setUp touch, splash, advance and clearInk do nothing.

    // One touch: x and y in pixels from the top left corner of the view. A stroke begins with the finger's coming down.
    // Ripples follow at once, the ink at `time` and a little later. `weight` is 1 for a finger, 0.3 to 1.5 for a pen.
    void touch(TouchAction action, double x, double y, float weight, double time);
    void touch(TouchAction action, double x, double y, float weight) { touch(action, x, y, weight, time_); }

    // Whether a finger is down.
    bool isTouched() const { return fingerDown_; }

    // Raises the ripple of a finger of this weight that comes down, without a finger and without ink.
    void splash(double x, double y, float weight);

    // Lets rain fall, `look.rainDropsPerSecond` drops a second, until it is switched off.
    void rain(bool falling) { raining_ = falling; }

    // Lets the breeze blow for good. Otherwise it sinks some seconds after the last ripple was raised.
    void blowAlways(bool always) { blowsAlways_ = always; }

    // Advances the water by `seconds` and says whether there is something to draw: while ink lives, when a step of it
    // is due, as each frame moves it; otherwise when the picture has changed since the last draw.
    bool advance(double seconds);

    // When advance() will next find something to draw, on the clock of time(), provided that isResting() is false.
    double due() const;

    // Whether the picture stays as it is, however much time passes, until the next call that changes something.
    bool isResting() const;

    // Whether ink lives, each step of which needs a frame: at most look.inkStepsPerSecond frames a second are drawn
    // then.
    bool inkMoves() const { return withInk_ && inkStart_ < 0.0 && (strokes_.isActive() || inkSteps_ > 0); }

    // Draws a frame: without ink into the current framebuffer, with ink into framebuffer 0. With ink, moves it by the
    // steps that are due, at least by one; steps beyond the fourth are left out, so that a late frame does not make the
    // next one late.
    void draw();

    // Lets all ink vanish with the next frame.
    void clearInk();

    // One height a point of the lattice: column by column from the left, each from the top.
    const std::vector<float>& heights() const { return heights_.values; }
    const WaveLattice& lattice() const { return lattice_; }

private:
    // A ripple that is being raised. Raised at once, it would be a facetted cone for some frames.
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
    int width_ = 0;  // view size, pixels
    int height_ = 0;
    std::minstd_rand random_;
    bool raining_ = false;
    bool withInk_ = false;
    bool isSetUp_ = false;
    bool changed_ = true;  // since the last draw
    bool isLost_ = false;  // what that has drawn
    double time_ = 0.0;

    int calmSteps_;          // calm steps in a row
    double dueSteps_ = 0.0;  // of the water that the time passed so far still asks for; below 0 when it is ahead
    std::vector<Drop> drops_;
    bool fingerDown_ = false;
    Place trail_ = {};  // where the finger raised its last ripple

    Breeze breeze_;
    bool blowsAlways_ = false;
    double calmAt_ = 0.0;  // when the breeze begins to sink
    double gust_ = 0.0;    // its share of its full strength, before it is smoothed

    StrokeClock strokes_;
    double inkStart_ = -1.0;  // when the ink that rested is to begin, or below 0
    double inkTime_ = 0.0;    // of the ink's last step
    int inkSteps_ = 0;        // until the ink has faded: the library does not tell whether any is left

    bool isGathered_ = false;  // the mesh has the heights of the lattice, and no others
    bool isMeshFilled_ = false;

    // The part of the square mesh that the view shows, in model units, and the whole numbers that the library takes for
    // the picture's extent.
    float visibleWidth_ = 0.0f;
    float visibleHeight_ = 0.0f;
    int pictureWidth_ = 0;
    int pictureHeight_ = 0;

    WaveLattice lattice_;
    FloatArray velocity_{0};
    FloatArray heights_{0};

    double meshShare_ = 1.0;
    SurfaceMesh mesh_{2, 2, 1.0, 1.0};
    int vertices_ = 0;  // of the mesh, along each side of the square
    FloatArray positions_{0};
    ShortArray indices_{0};
    FloatArray heightAttribs_{0};
    FloatArray mvp_{16};
};

}  // namespace tidemark
