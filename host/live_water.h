// Water on a screen that is looked at: takes what happens (touches, another size, other pictures, another look) and
// draws a frame when something has changed. Every face with a screen is around it: the view on Android, the element in
// the browser, the window on the desktop.
//
// Call everything on the one thread that owns the OpenGL ES 2.0 context; the context itself is needed by frame() only.
// Times are seconds of the clock that the face gives to frame().
#pragma once

#include <cstdint>
#include <vector>

#include "host/look.h"
#include "host/pace.h"
#include "host/picture_source.h"
#include "host/shade.h"
#include "host/view_size.h"
#include "host/water_host.h"

namespace tidemark {

struct LookField;

// The weight of a pen's pressure of 0 to 1: 0.3 to 1.5. A finger or a mouse weighs 1, as few screens measure its
// pressure.
float penWeight(float pressure);

double steadySeconds();

class LiveWater {
public:
    enum class Frame {
        resting = 0,  // nothing to draw until the next call that changes something
        waiting = 1,  // nothing to draw before due()
        drawn = 2,
        resize = 3,  // nothing was drawn: give the surface width() x height() pixels, then call resized()
    };

    // Seconds of a clock that goes on while a frame is drawn.
    using Clock = double (*)();

    // `seed` fixes where the rain falls.
    LiveWater(PictureSource pictures, std::uint32_t seed, Clock clock = steadySeconds);

    // The view in density-independent pixels, and how many pixels of the display each of them has. Frames go on in the
    // old size until the view has kept its size for a tenth of a second. The ink is lost then, the water stays.
    void setView(double width, double height, double density, double now);

    // How many pixels are drawn for a density-independent one at most; automatic at first.
    void setQuality(Quality quality);

    // The least seconds that the face lets pass between two frames, 0 at first: these are not late then.
    void setShortestFrame(double seconds) { shortestFrame_ = seconds; }

    int width() const { return wanted_.width; }
    int height() const { return wanted_.height; }
    void resized();

    // Takes over all values; the water and the ink stay. Returns null, or the first value beyond its limits: then
    // nothing changes.
    const LookField* setLook(const Look& look);

    // Whether touches drop ink; they do not at first. A switch ends the stroke that is being drawn.
    void setInk(bool withInk);

    void setRain(bool falling) { host_.rain(falling); }

    // Lets the breeze blow for good. Otherwise it sinks some seconds after the last ripple was raised, and the water
    // rests.
    void setBreezeAlways(bool always) { host_.blowAlways(always); }
    void clearInk() { host_.clearInk(); }

    // One touch at the time at which it was reported. The place is a share of the view's width and height, from its top
    // left corner. A cancel ends a stroke as lifting the finger does.
    void touch(TouchAction action, float x, float y, float weight, double time);

    // Raises a ripple with the next frame, even if that is the first one. With ink it acts as a finger that comes down
    // and is lifted at once, unless a finger is down: the ink follows one stroke at a time.
    void splash(float x, float y, float weight, bool withInk = false);

    // Nothing is drawn before all three pictures were there once. `which` is a sum of k...Picture.
    void picturesChanged(unsigned which);

    // The factors that a face multiplies a picture's colours by before it hands it over, see shade.h. A look that
    // changes it has the pictures handed over again.
    Shade shade(PictureSlot slot, float brightness) const { return shadeOf(host_.look(), slot, brightness); }

    // Where the framebuffer has lost the last frame.
    void redraw() { host_.redraw(); }

    // After a lost context.
    void renewContext();

    // Whether there is nothing to draw until the next call that changes something.
    bool isResting() const;

    // Brings the water to the time `now`, that at which the display shows the frame, and draws it where it has changed:
    // without ink into the current framebuffer, with ink into framebuffer 0.
    Frame frame(double now);

    // When frame() will next have something to do: infinity while the water rests, in the past for the next frame.
    double due() const;

private:
    struct Splash {
        float x, y, weight;
        bool withInk;
    };

    void prepare();
    void draw(double seconds);
    void fitSurface();
    bool isSurfaceDue() const;
    double secondsUntil(double now);

    WaterHost host_;
    PictureSource pictures_;
    Clock clock_;
    Pace pace_;
    bool withInk_ = false;

    Quality quality_ = Quality::automatic;
    ViewSize view_;
    Size wanted_ = {0, 0};    // what the view asks for
    Size asked_ = {0, 0};     // what the face was last told to give the surface
    Size surface_ = {0, 0};   // what the surface has
    double settledAt_ = 0.0;  // when the view will have kept its size long enough

    // Reported since the last frame; places are shares of the view, times those of the face.
    std::vector<Touch> touches_;
    std::vector<Splash> splashes_;

    double longestFrame_ = Look{}.longestFrame;
    double shortestFrame_ = 0.0;
    bool isRunning_ = false;  // or the last frame was before a rest
    double now_ = 0.0;        // of the last frame

    // Changes that the next frame passes to the library, because the context is current only there.
    bool setUpDue_ = false;
    bool isContextNew_ = true;
    unsigned pictureDue_ = 0;   // to be handed over
    unsigned texturesDue_ = 0;  // besides those
    unsigned known_ = 0;        // pictures that were there once
    double proportions_ = 0.0;  // to which the backgrounds were last cropped
    int longest_ = 0;           // and the view's longer side then
};

}  // namespace tidemark
