// Water on a screen that is looked at: takes what happens (touches, another size, other pictures, another look) and
// draws a frame when something has changed. The page in the browser and the window on the desktop are both around it.
//
// Call everything on the one thread that owns the OpenGL ES 2.0 context; the context itself is needed by frame() only.
#pragma once

#include <cstdint>
#include <utility>

#include "host/frame_clock.h"
#include "host/look.h"
#include "host/picture.h"
#include "host/water_host.h"

class LiveWater {
public:
    enum class Frame {
        resting,  // nothing to draw until the next call that changes something
        waiting,  // nothing to draw yet
        drawn,
    };

    // `seed` fixes where the rain falls.
    LiveWater(const Look& look, std::uint32_t seed);

    // Nothing is drawn before the first pictures. Hands over only those that differ from the last ones.
    void setPictures(Pictures pictures);

    // In pixels, each at least 1. The ink is lost, the water stays.
    void resize(int width, int height);

    void setLook(const Look& look) { host_.setLook(look); }

    // Whether touches drop ink; they do not at first. A switch ends the stroke that is being drawn.
    void setInk(bool withInk);

    void setRain(bool falling) { host_.rain(falling); }
    void clearInk() { host_.clearInk(); }
    void touch(TouchAction action, int x, int y, float pressure) { host_.touch(action, x, y, pressure); }

    void splash(int x, int y, float pressure) { host_.splash(x, y, pressure); }

    // Where the framebuffer has lost the last frame.
    void redraw() { host_.redraw(); }

    // After a lost context.
    void renewContext();

    // Whether there is nothing to draw until the next call that changes something.
    bool isResting() const;

    // Shorter by longer side of what the backgrounds are cropped to.
    double proportions() const { return host_.proportions(); }

    // What the processor spent on the last frame, in seconds; frames that take long make the mesh coarser. One that set
    // the library up or took pictures over says nothing of the next ones.
    void noteWork(double seconds) {
        if (!std::exchange(prepared_, false)) host_.noteWork(seconds);
    }

    // Does what frame() does before it draws: sets the library up and loads what was handed over, where that is due.
    void prepare();

    // Brings the water to the time `now`, in seconds, and draws it where it has changed: without ink into the current
    // framebuffer, with ink into framebuffer 0.
    Frame frame(double now);

private:
    WaterHost host_;
    FrameClock clock_;
    Pictures pictures_;
    bool withInk_ = false;

    // What the library has not been told yet; the next frame does, where the context is current.
    bool setUpDue_ = true;
    unsigned handOverDue_ = 0;
    unsigned texturesDue_ = 0;  // besides those handed over
    double proportions_ = 0.0;  // to which the backgrounds were last cropped
    bool prepared_ = false;     // what was due, since the last noteWork()
};
