// A context that is lost in the middle of a gesture, over and over.
#include <malloc.h>
#include <unistd.h>

#include <fstream>
#include <functional>
#include <iostream>
#include <random>
#include <string_view>

#include "host/water_host.h"
#include "tests/endurance/lengths.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "tests/support/library_blocks.h"
#include "tests/support/test_pictures.h"

namespace {

struct GlObjects {
    int buffers = 0;
    int textures = 0;
    int framebuffers = 0;
    int programs = 0;
    int shaders = 0;
    bool operator==(const GlObjects&) const = default;

    // Of every kind.
    bool operator<=(const GlObjects& o) const {
        return buffers <= o.buffers && textures <= o.textures && framebuffers <= o.framebuffers &&
               programs <= o.programs && shaders <= o.shaders;
    }
};

std::ostream& operator<<(std::ostream& out, const GlObjects& o) {
    return out << o.buffers << " buffers, " << o.textures << " textures, " << o.framebuffers << " framebuffers, "
               << o.programs << " programs, " << o.shaders << " shaders";
}

// Drivers give out small names first. Those never bound do not count.
GlObjects liveObjects() {
    GlObjects live;
    for (GLuint name = 1; name < 500; ++name) {
        live.buffers += glIsBuffer(name);
        live.textures += glIsTexture(name);
        live.framebuffers += glIsFramebuffer(name);
        live.programs += glIsProgram(name);
        live.shaders += glIsShader(name);
    }
    return live;
}

long residentKib() {
    // What is free but not given back would hide a growth.
    malloc_trim(0);
    long total = 0;
    long resident = 0;
    std::ifstream("/proc/self/statm") >> total >> resident;
    return resident * (sysconf(_SC_PAGESIZE) / 1024);
}

// A sanitizer keeps what was freed.
#ifdef __SANITIZE_ADDRESS__
constexpr bool kSanitized = true;
#else
constexpr bool kSanitized = false;
#endif

struct View {
    int width;
    int height;
};

constexpr View kUpright = {180, 240};
constexpr View kAcross = {240, 180};
constexpr int kTarget = 240;  // side of framebuffer 0, room for both

// A stroke, in the middle of which the view may turn and the ink be switched.
struct Stroke {
    View view = kUpright;
    bool withInk = false;
    bool rain = false;
    int x = 0;
    int y = 0;
    int dx = 0;  // a frame
    int dy = 0;
};

std::vector<Stroke> strokes(int number) {
    std::mt19937 random(7);
    const auto pick = [&random](int from, int to) {
        return from + static_cast<int>(random() % static_cast<unsigned>(to - from + 1));
    };
    std::vector<Stroke> made;
    Stroke next;
    for (int i = 0; i < number; ++i) {
        if (pick(1, 4) == 1) next.withInk = !next.withInk;
        if (pick(1, 4) == 1) next.view = next.view.width == kUpright.width ? kAcross : kUpright;
        next.rain = pick(1, 3) == 1;
        next.x = pick(80, 100);
        next.y = pick(80, 100);
        // From a resting finger to a fast one.
        next.dx = pick(0, 12);
        next.dy = pick(-1, 1);
        made.push_back(next);
    }
    return made;
}

// Six steps of the water and the finger; `interrupt` is called after the third.
void play(WaterHost& host, const Stroke& s, bool drawing, const std::function<void()>& interrupt) {
    host.rain(s.rain);
    host.touch(TouchAction::down, s.x, s.y, 1.0f);
    for (int i = 1; i <= 6; ++i) {
        host.advance(1.0 / 60);
        if (drawing) host.draw();
        host.touch(TouchAction::move, s.x + i * s.dx, s.y + i * s.dy, 1.0f);
        if (i == 3) interrupt();
    }
    if (drawing) host.draw();
    host.touch(TouchAction::up, s.x + 6 * s.dx, s.y + 6 * s.dy, 1.0f);
}

class LostContexts : public GlTest {
protected:
    // In a new context and a library freshly loaded, but for its buffers.
    WaterHost start() {
        renewContext(kTarget, kTarget);
        resetGestures();
        Look look;
        look.meshVertices = 32;
        WaterHost host(look, kUpright.width, kUpright.height, 1);
        host.handOver({smoothPicture(24, 32, 1), smoothPicture(32, 24, 2), smoothPicture(8, 8, 3)});
        return host;
    }

    // What a first set-up of the mode makes, once its first frame has bound it all.
    GlObjects firstSetUp(bool withInk) {
        WaterHost host = start();
        host.setUp(withInk);
        host.draw();
        return liveObjects();
    }

    static std::size_t picture(View view) {
        const auto pixels = readPixels(view.width, view.height);
        return std::hash<std::string_view>()(
            {reinterpret_cast<const char*>(pixels.data()), pixels.size() * sizeof pixels[0]});
    }
};

}  // namespace

TEST_F(LostContexts, everySetUpMakesTheSameObjectsAndTheWaterGoesOn) {
    // By then both modes and both views have been set up. What the driver holds goes up and down by 4 MiB.
    constexpr std::size_t kWarmUp = 15;
    constexpr long kAllowanceKib = 6 * 1024;
    const int losses = isFullLength() ? 1000 : 40;
    const std::vector<Stroke> script = strokes(losses);

    // The same fingers on the same water in one context that lives. The ink is the library's and is not compared, so
    // it need not be drawn.
    std::vector<std::size_t> undisturbed;
    {
        WaterHost host = start();
        host.setUp(false);
        Stroke before;
        for (const Stroke& s : script) {
            play(host, s, false, [&] {
                if (s.withInk == before.withInk && s.view.width == before.view.width) return;
                host.resize(s.view.width, s.view.height);
                host.setUp(s.withInk);
            });
            host.clearInk();
            host.draw();
            undisturbed.push_back(picture(s.view));
            before = s;
        }
    }

    const GlObjects first[] = {firstSetUp(false), firstSetUp(true)};
    std::cout << "water: " << first[0] << "\nwith ink: " << first[1] << '\n';
    WaterHost host = start();
    host.setUp(false);
    int blocks = 0;
    long resident = 0;
    bool inkBefore = false;
    for (std::size_t n = 0; n < script.size(); ++n) {
        SCOPED_TRACE(n);
        const Stroke& s = script[n];
        play(host, s, true, [&] {
            const GLenum error = glGetError();
            EXPECT_TRUE(error == GL_NO_ERROR || error == GL_INVALID_VALUE) << error;
            renewContext(kTarget, kTarget);
            host.resize(s.view.width, s.view.height);
            host.setUp(s.withInk);
            host.draw();
            EXPECT_EQ(liveObjects(), first[s.withInk]);
        });
        host.draw();
        const std::size_t inked = picture(s.view);
        host.clearInk();
        host.draw();
        ASSERT_EQ(picture(s.view), undisturbed[n]);
        EXPECT_EQ(inked != undisturbed[n], s.withInk && inkBefore) << "a stroke goes on where the ink stays on";
        inkBefore = s.withInk;
        if (n == kWarmUp) {
            blocks = LibraryBlocks::live;
            resident = residentKib();
        }
        log.take();
    }
    EXPECT_EQ(LibraryBlocks::live, blocks);
    const long residentAtEnd = residentKib();
    std::cout << losses << " contexts lost: " << blocks << " blocks, resident " << resident << " KiB after " << kWarmUp
              << " and " << residentAtEnd << " KiB at the end\n";
    if (!kSanitized) {
        EXPECT_LT(residentAtEnd, resident + kAllowanceKib);
    }
}

TEST_F(LostContexts, noSequenceOfSetUpsPilesObjectsUpOrTakesAnotherOnesAway) {
    const int setUps = isFullLength() ? 1000 : 100;
    const GlObjects water = firstSetUp(false);
    const std::size_t waterPicture = picture(kUpright);
    const GlObjects all = firstSetUp(true);
    const std::size_t inkPicture = picture(kUpright);
    const int blocks = LibraryBlocks::live;
    WaterHost host = start();
    std::mt19937 random(3);
    bool hadInk = false;
    int spared = 0;
    for (int i = 0; i < setUps; ++i) {
        SCOPED_TRACE(i);
        if (random() % 2 == 0) {
            renewContext(kTarget, kTarget);
            hadInk = false;
        }
        const bool withInk = random() % 2 == 0;
        host.setUp(withInk);
        host.draw();
        EXPECT_EQ(picture(kUpright), withInk ? inkPicture : waterPicture);
        // The water alone leaves the objects of the ink as they are. Where it follows a lost context with ink, an
        // object whose name a member of the ink still holds from there is spared: one for each such member, at the
        // most.
        hadInk = hadInk || withInk;
        const GlObjects live = liveObjects();
        ASSERT_TRUE(live == all || (!hadInk && water <= live && live <= all)) << live;
        spared += !hadInk && live != water;
        ASSERT_LE(LibraryBlocks::live, blocks);
        log.take();
    }
    std::cout << setUps << " set-ups, objects spared after " << spared << '\n';
}
