// Loses the context in the middle of many gestures.
#include <algorithm>
#include <functional>
#include <random>
#include <string_view>

#include "probes/gesture_state.h"
#include "probes/library_blocks.h"
#include "tests/endurance/strokes.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

// Buffers, textures, framebuffers, programs, shaders.
using GlObjects = std::array<int, 5>;

// Counts the live objects. Drivers assign small names first; a name that was never bound does not count.
GlObjects liveObjects() {
    GlObjects live = {};
    for (GLuint name = 1; name < 500; ++name) {
        live[0] += glIsBuffer(name);
        live[1] += glIsTexture(name);
        live[2] += glIsFramebuffer(name);
        live[3] += glIsProgram(name);
        live[4] += glIsShader(name);
    }
    return live;
}

bool isWithin(const GlObjects& fewer, const GlObjects& more) {
    return std::ranges::equal(fewer, more, std::less_equal<>());
}

class LostContexts : public GlTest {
protected:
    static constexpr int kShorter = 180;  // sides of the view
    static constexpr int kLonger = 240;

    struct Mode {
        int width = kShorter, height = kLonger;
        bool withInk = false;
        bool operator==(const Mode&) const = default;
    };

    // Creates a host in a new context, with the library in its state after loading.
    WaterHost start() {
        renewContext(kLonger, kLonger);
        resetGestures();
        WaterHost host(Look{.meshVertices = 32}, kShorter, kLonger, 1);
        return host;
    }

    static std::size_t picture(WaterHost& host, const Mode& mode) {
        host.draw();
        const auto pixels = readPixels(mode.width, mode.height);
        return std::hash<std::string_view>()(
            {reinterpret_cast<const char*>(pixels.data()), pixels.size() * sizeof pixels[0]});
    }

    // Counts the objects of a first set-up, after a frame has bound them all.
    GlObjects firstSetUp(bool withInk) {
        WaterHost host = start();
        setUp(host, withInk, kAllPictures);
        host.touch(TouchAction::down, 90, 120, 1.0f);
        host.advance(1.0 / 60);
        host.draw();
        return liveObjects();
    }

    // Sets up the library again, in the current context or in a new one.
    void setUpAgain(WaterHost& host, const Mode& mode, bool inNewContext) {
        EXPECT_EQ(glGetError(), GLenum{GL_NO_ERROR});
        if (inNewContext) renewContext(kLonger, kLonger);
        hadInk_ = mode.withInk || (hadInk_ && !inNewContext);
        host.resize(mode.width, mode.height);
        setUp(host, mode.withInk);
        // Deleting a program name of a lost context sets GL_INVALID_VALUE.
        const GLenum error = glGetError();
        EXPECT_TRUE(error == GL_NO_ERROR || error == GL_INVALID_VALUE) << error;
        host.draw();
        // A set-up without ink keeps the ink's objects. After a lost context with ink, it also keeps an object whose
        // name equals a stale name of the ink; see gl/objects.h.
        const GlObjects live = liveObjects();
        EXPECT_TRUE(
            live == first_[hadInk_] ||
            (!inNewContext && isWithin(first_[hadInk_], live) && isWithin(live, first_[true])))
            << testing::PrintToString(live);
        log.take();
    }

    GlObjects first_[2];
    bool hadInk_ = false;  // in the current context
};

}  // namespace

TEST_F(LostContexts, recoverWithOneSetUpDuringAStroke) {
    const std::vector<Stroke> strokes = strokesOfAllKinds();
    first_[false] = firstSetUp(false);
    first_[true] = firstSetUp(true);
    const int blocks = LibraryBlocks::live;
    const int losses = isFullLength() ? 1000 : 20;
    std::vector<std::size_t> undisturbed;
    int continuedStrokes = 0;
    // The first round records the pictures of the water without losses. It does not draw the ink, which is not
    // compared.
    for (const bool losing : {false, true}) {
        WaterHost host = start();
        setUp(host, false, kAllPictures);
        std::mt19937 random(7);
        const auto oneIn = [&random](unsigned chances) { return random() % chances == 0; };
        Mode mode;
        for (int lost = 0, n = 0; lost < losses; ++n) {
            SCOPED_TRACE(n);
            const Stroke& stroke = strokes[random() % strokes.size()];
            const Mode before = mode;
            if (oneIn(4)) mode.withInk = !mode.withInk;
            if (oneIn(4)) std::swap(mode.width, mode.height);
            host.rain(oneIn(3));
            const bool inNewContext = !oneIn(3);
            lost += inNewContext;
            for (std::size_t i = 0; i < 7; ++i) {
                const Mode& now = i < 4 ? before : mode;
                if (i == 4 && losing) {
                    setUpAgain(host, mode, inNewContext);
                } else if (i == 4 && mode != before) {
                    host.resize(mode.width, mode.height);
                    setUp(host, mode.withInk);
                }
                if (i < stroke.size()) {
                    const StrokeEvent& event = stroke[i];
                    host.touch(event.action, event.x * now.width, event.y * now.height, 1.0f);
                }
                host.advance(1.0 / 60);
                if (losing) host.draw();
            }
            const std::size_t inked = picture(host, mode);
            host.clearInk();
            const std::size_t water = picture(host, mode);
            if (!losing) {
                undisturbed.push_back(water);
                continue;
            }
            ASSERT_EQ(water, undisturbed[static_cast<std::size_t>(n)]);
            continuedStrokes += inked != water && before.withInk && inNewContext;
            ASSERT_TRUE(inked == water || mode.withInk);
            ASSERT_LE(LibraryBlocks::live, blocks);
        }
    }
    EXPECT_GT(continuedStrokes, losses / 8);
}
