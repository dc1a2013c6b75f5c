// A context that is lost in the middle of a gesture, over and over.
#include <algorithm>
#include <functional>
#include <random>
#include <string_view>

#include "probes/gesture_state.h"
#include "probes/library_blocks.h"
#include "tests/endurance/strokes.h"
#include "tests/support/gl_test.h"

namespace {

// Buffers, textures, framebuffers, programs, shaders.
using GlObjects = std::array<int, 5>;

// Drivers give out small names first. Those never bound do not count.
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

    // In a new context and a library freshly loaded, but for its buffers.
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

    // What a first set-up of the mode makes, once its first frame has bound it all.
    GlObjects firstSetUp(bool withInk) {
        WaterHost host = start();
        setUp(host, withInk, kAllPictures);
        host.touch(TouchAction::down, 90, 120, 1.0f);
        host.advance(1.0 / 60);
        host.draw();
        return liveObjects();
    }

    // In the middle of each stroke the library is set up again, in a context that lives or in a new one.
    void setUpAgain(WaterHost& host, const Mode& mode, bool inNewContext) {
        EXPECT_EQ(glGetError(), GLenum{GL_NO_ERROR});
        if (inNewContext) renewContext(kLonger, kLonger);
        hadInk_ = mode.withInk || (hadInk_ && !inNewContext);
        host.resize(mode.width, mode.height);
        setUp(host, mode.withInk);
        // A context does not know the names of a lost one.
        const GLenum error = glGetError();
        EXPECT_TRUE(error == GL_NO_ERROR || error == GL_INVALID_VALUE) << error;
        host.draw();
        // The water alone leaves the objects of the ink as they are. Where it follows a lost context with ink, an
        // object whose name a member of the ink still holds from there is spared.
        const GlObjects live = liveObjects();
        EXPECT_TRUE(
            live == first_[hadInk_] ||
            (!inNewContext && isWithin(first_[hadInk_], live) && isWithin(live, first_[true])))
            << testing::PrintToString(live);
        log.take();
    }

    GlObjects first_[2];
    bool hadInk_ = false;  // this context
};

}  // namespace

TEST_F(LostContexts, costOneSetUpEvenInTheMiddleOfAStroke) {
    const std::vector<Stroke> strokes = strokesOfAllKinds();
    first_[false] = firstSetUp(false);
    first_[true] = firstSetUp(true);
    const int blocks = LibraryBlocks::live;
    const int losses = isFullLength() ? 1000 : 20;
    std::vector<std::size_t> undisturbed;
    int strokesGoneOn = 0;
    // First the same fingers on the same water where nothing is lost. The ink is the library's and is not compared, so
    // it need not be drawn.
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
            strokesGoneOn += inked != water && before.withInk && inNewContext;
            ASSERT_TRUE(inked == water || mode.withInk);
            ASSERT_LE(LibraryBlocks::live, blocks);
        }
    }
    EXPECT_GT(strokesGoneOn, losses / 8);
}
