// The water on a screen: receives events (touches, size, pictures, look) and draws a frame when something has changed.
// The view on Android, the element in the browser and the window on the desktop each contain one.
//
// Call everything on the thread that owns the OpenGL ES 2.0 context. Only frame() requires the context to be current.
// Times are seconds on the clock of the front end that calls frame().
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

// Returns the weight of a pen's pressure, 0 to 1: 0.3 to 1.5. A finger or mouse has the weight 1, because few screens
// measure its pressure.
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

    // Returns the seconds of a clock that advances during a frame.
    using Clock = double (*)();

    // `seed` determines the rain.
    LiveWater(PictureSource pictures, std::uint32_t seed, Clock clock = steadySeconds);

    // Sets the size of the view in density-independent pixels and the number of display pixels for each of them. The
    // size is applied after it has not changed for 0.1 seconds; until then frames are drawn in the old size. Water is
    // kept, ink is lost.
    void setView(double width, double height, double density, double now);

    // Limits the number of drawn pixels per density-independent pixel. The default is automatic.
    void setQuality(Quality quality);

    // Sets the front end's minimum interval between two frames in seconds, so that such frames do not count as late.
    // The default is 0.
    void setShortestFrame(double seconds) { shortestFrame_ = seconds; }

    int width() const { return wanted_.width; }
    int height() const { return wanted_.height; }
    void resized();

    // Sets all values; water and ink are kept. Returns null, or the first value outside its limits, in which case
    // nothing changes.
    const LookField* setLook(const Look& look);

    // Sets whether touches add ink; the default is false. A change ends the current stroke.
    void setInk(bool withInk);

    void setRain(bool falling) { host_.rain(falling); }

    // If true, the breeze never ends. Otherwise it fades some seconds after the last ripple, and the water rests.
    void setBreezeAlways(bool always) { host_.blowAlways(always); }
    void clearInk() { host_.clearInk(); }

    // Adds a touch with the time of its report. The position is a fraction of the view's width and height, from the top
    // left. A cancel ends a stroke as an up does.
    void touch(TouchAction action, float x, float y, float weight, double time);

    // Raises a ripple with the next frame. With ink it acts as a touch that is lifted immediately. While a finger is
    // down it adds no ink, because the library has one stroke at a time.
    void splash(float x, float y, float weight, bool withInk = false);

    // Reports new pictures, as a sum of k...Picture. Nothing is drawn before all three have been reported once, but
    // frame() sets up the library, which compiles its programs.
    void picturesChanged(unsigned which);

    // Returns the factors for a picture's colours, which the front end applies before the transfer; see shade.h. If a
    // new look changes them, the pictures are requested again.
    Shade shade(PictureSlot slot, float brightness) const { return shadeOf(host_.look(), slot, brightness); }

    // Call it when the framebuffer has lost the last frame.
    void redraw() { host_.redraw(); }

    // Call it after a context loss.
    void renewContext();

    // Returns whether there is nothing to draw until the next call that changes something.
    bool isResting() const;

    // Advances the water to `now`, the time at which the display shows the frame, and draws it if it has changed:
    // without ink into the current framebuffer, with ink into framebuffer 0.
    Frame frame(double now);

    // Returns when frame() will next draw or set up: infinity while the water rests, a time in the past if immediately.
    double due() const;

private:
    struct Splash {
        float x, y, weight;
        bool withInk;
    };

    bool prepare();
    void draw(double seconds);
    void fitSurface();
    bool isSurfaceDue() const;
    bool isChangeDue() const;
    bool isStill() const;
    double secondsUntil(double now);

    WaterHost host_;
    PictureSource pictures_;
    Clock clock_;
    Pace pace_;
    bool withInk_ = false;

    Quality quality_ = Quality::automatic;
    ViewSize view_;
    Size wanted_ = {0, 0};    // size for the view
    Size asked_ = {0, 0};     // size last requested from the front end
    Size surface_ = {0, 0};   // current size
    double settledAt_ = 0.0;  // when a new size is applied

    // Events since the last frame. Positions are fractions of the view, times are on the front end's clock.
    std::vector<Touch> touches_;
    std::vector<Splash> splashes_;

    double longestFrame_ = Look{}.longestFrame;
    double shortestFrame_ = 0.0;
    bool isRunning_ = false;  // false before the first frame and after a rest
    double now_ = 0.0;        // time of the last frame

    // Changes that the next frame passes to the library, because only then the context is current.
    bool setUpDue_ = false;
    unsigned pictureDue_ = 0;   // pictures to transfer
    unsigned texturesDue_ = 0;  // further textures to load
    unsigned known_ = 0;        // pictures that have been reported
    double proportions_ = 0.0;  // of the backgrounds at their last transfer
    int longest_ = 0;           // longer side of the view at that time
};

}  // namespace tidemark
