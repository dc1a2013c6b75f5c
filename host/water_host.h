// The reference host: what an app does around the library, in the order that the library asks for. It owns the mesh
// arrays, the view, the transform and the lighting values, turns touches and rain into ripples, steps water and ink in
// time and tells when there is nothing new to draw.
//
// Call everything on the one thread that owns the OpenGL ES 2.0 context.
#pragma once

#include <cstdint>
#include <random>
#include <vector>

#include "host/host_jni.h"
#include "host/look.h"
#include "host/mesh_quality.h"
#include "host/picture.h"
#include "host/surface_mesh.h"
#include "host/wave_lattice.h"

// The action codes of android.view.MotionEvent.
enum class TouchAction { down = 0, up = 1, move = 2, cancel = 3 };

class WaterHost {
public:
    // `seed` fixes where the rain falls. The view is width x height pixels, each at least 1.
    WaterHost(const Look& look, int width, int height, std::uint32_t seed);

    // setUp must follow, and before it another hand-over of the backgrounds where the proportions have changed. The
    // water stays.
    void resize(int width, int height);

    // Shorter by longer side of what the backgrounds are cropped to in portrait and in landscape.
    double proportions() const;

    // Hands pictures over, of which the library keeps copies; before setUp or loadTextures.
    void handOver(const Pictures& pictures, unsigned which = Pictures::kAll);

    // Sets the library up in the current context, with or without ink. A new context needs all textures; one that goes
    // on, with another size or mode, keeps those that it has.
    void setUp(bool withInk, unsigned textures = Pictures::kAll);

    // Shows pictures handed over since setUp; the water and the ink stay as they are.
    void loadTextures(unsigned which = Pictures::kAll);

    // Takes over all values, brought within their limits; the water and the ink stay.
    void setLook(const Look& look);

    // What the processor spent on a frame, in seconds: where the look leaves the mesh to the host, it gets coarser when
    // frames take long.
    void noteWork(double seconds);

    // Where the framebuffer has lost the last frame.
    void redraw() { changed_ = true; }

    // Before the first setUp touch, advance and clearInk do nothing.

    // One touch event; x and y in pixels from the top left corner of the view, pressure around 1. A stroke begins with
    // the finger's coming down.
    void touch(TouchAction action, int x, int y, float pressure);

    // Raises the ripple of a finger of this pressure that comes down, without a finger and without ink.
    void splash(int x, int y, float pressure);

    // Lets rain fall, `look.rainDropsPerSecond` drops a second, until it is switched off.
    void rain(bool falling) { raining_ = falling; }

    // Advances the water by `seconds` and says whether there is something to draw: while ink lives, when a step of it
    // is due, as each frame moves it; otherwise when the picture has changed since the last draw.
    bool advance(double seconds);

    // Whether the picture stays as it is, however much time passes, until the next call that changes something.
    bool isResting() const;

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
    void fit();
    int wantedVertices() const { return look_.meshVertices > 1 ? look_.meshVertices : quality_.vertices(); }
    void makeMesh(int vertices);
    void fillMesh();
    void raiseTouchRipples(TouchAction action, int x, int y, float amplitude);
    void stepWater();
    void dropRain();
    void raiseRipple(float x, float y, float amplitude);  // position in model units
    void gatherHeights();
    bool inkMoves() const { return (withInk_ && fingerDown_) || inkSteps_ > 0; }

    Look look_;
    int width_ = 0;  // view size, pixels
    int height_ = 0;
    std::minstd_rand random_;
    bool raining_ = false;
    bool withInk_ = false;
    bool isSetUp_ = false;
    bool fingerDown_ = false;
    int inkSteps_ = 0;       // until the ink has faded: the library does not tell whether any is left
    bool changed_ = true;    // since the last draw
    int calmSteps_;          // calm steps in a row
    double dueSteps_ = 0.0;  // of the water that the time passed so far still asks for; below 0 when it is ahead
    double dueInkSteps_ = 0.0;
    bool isGathered_ = false;  // the mesh has the heights of the lattice
    bool isMeshFilled_ = false;
    float touchX_ = 0.0f;  // where the finger raised its last ripple, model units
    float touchY_ = 0.0f;

    // The part of the square mesh that the view shows, in model units, and the whole numbers at or above it, which
    // the library takes for the picture's extent.
    float visibleWidth_ = 0.0f;
    float visibleHeight_ = 0.0f;
    int pictureWidth_ = 0;
    int pictureHeight_ = 0;

    WaveLattice lattice_;
    FloatArray velocity_{0};
    FloatArray heights_{0};

    MeshQuality quality_;
    SurfaceMesh mesh_{2, 2, 1.0, 1.0};
    int vertices_ = 0;  // of the mesh, along each side of the square
    FloatArray positions_{0};
    ShortArray indices_{0};
    FloatArray heightAttribs_{0};
    FloatArray mvp_{16};
};
