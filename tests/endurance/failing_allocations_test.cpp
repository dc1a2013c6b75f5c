// Makes each allocation of the library fail once, then all of them.
#include <climits>
#include <map>

#include "gl/shader_program.h"
#include "probes/gesture_state.h"
#include "probes/library_blocks.h"
#include "tests/endurance/strokes.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

class FailingAllocations : public GlTest {
protected:
    static constexpr int kLargestView = 468;

    struct Shown {
        std::vector<Rgba> inked, water;
    };

    void SetUp() override {
        renewContext(kLargestView, kHeight);
        resetGestures();
    }

    // Draws a tap for a few frames, then clears the ink.
    Shown play() const {
        const Look look = {.meshVertices = vertices_};
        // The transfer through a square view makes the cropping independent of width_, so that a picture kept after a
        // failure equals the new one.
        WaterHost square(look, 64, 64, 1);
        setUp(square, false, kAllPictures);
        WaterHost host(look, width_, kHeight, 1);
        setUp(host, true);
        srand48(1);
        // A shader that does not compile makes the library allocate memory for its info log.
        zorloadShaderScript(GL_VERTEX_SHADER, "void main( {");
        host.touch(TouchAction::down, width_ / 2, kHeight / 2, 1.0f);
        for (int i = 0; i < 3; ++i) {
            host.advance(1.0 / 60);
            host.draw();
        }
        Shown shown;
        shown.inked = readPixels(width_, kHeight);
        host.clearInk();
        host.draw();
        shown.water = readPixels(width_, kHeight);
        return shown;
    }

    struct Session {
        Shown disturbed, undisturbed;
        std::string complaint;  // first error line, up to its numbers
        int complaints = 0;     // error lines about memory
        int texts = 0;          // logged info logs
    };

    // Plays once while the requests first ... last fail, checks that the next set-up recovers, and plays once without
    // failures for comparison.
    Session fail(int first, int last) {
        // A larger view and mesh make the buffers that never shrink allocate again.
        width_ += 12;
        ++vertices_;
        resetGestures();
        log.take();
        LibraryBlocks::requested = 0;
        LibraryBlocks::failFirst = first;
        LibraryBlocks::failLast = last;
        Session session;
        session.disturbed = play();
        LibraryBlocks::failFirst = LibraryBlocks::failLast = 0;
        for (const std::string& line : log.take()) {
            session.texts += line.starts_with("E Could not compile");
            if (!line.starts_with("E no memory") && !line.starts_with("E cannot")) continue;
            if (session.complaints++ == 0) session.complaint = line.substr(2, line.find_first_of("0123456789") - 2);
        }
        const Shown recovered = play();
        resetGestures();
        session.undisturbed = play();
        EXPECT_TRUE(recovered.water == session.undisturbed.water && recovered.inked == session.undisturbed.inked);
        EXPECT_FALSE(recovered.inked == recovered.water) << "ink is seen";
        return session;
    }

private:
    static constexpr int kHeight = 144;
    int width_ = 300;
    int vertices_ = 40;
};

double meanDifference(const std::vector<Rgba>& a, const std::vector<Rgba>& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.size(); ++i) sum += std::abs(a[i][0] - b[i][0]);
    return sum / static_cast<double>(a.size());
}

}  // namespace

TEST_F(FailingAllocations, affectOnlyTheirFeatureUntilTheNextSetUp) {
    play();  // Transfers pictures that a failed transfer can keep.
    std::map<std::string, int> seen;
    for (int request = 1;; ++request) {
        const auto [disturbed, undisturbed, complaint, complaints, texts] = fail(request, request);
        if (complaints == 0 && texts == 1) break;  // All requests have failed once.
        SCOPED_TRACE(std::to_string(request) + " " + complaint);
        ++seen[complaint];
        EXPECT_EQ(complaints, texts) << "a failure is logged, or loses the info log";
        EXPECT_EQ(disturbed.inked == disturbed.water, complaint == "no memory for an ink grid of ");
        EXPECT_EQ(disturbed.water == undisturbed.water, complaint != "no memory for smoothing the water");
        EXPECT_LT(meanDifference(disturbed.water, undisturbed.water), 0.5) << "one step may lack smoothing";
    }
    const std::map<std::string, int> wanted = {
        {"", 1},
        {"cannot copy a bitmap of ", 3},
        {"no memory for an ink grid of ", 5},
        {"no memory for smoothing the water", 1},
        {"no memory for uploading the ink's velocity", 1}};
    EXPECT_EQ(seen, wanted);

    const Session starved = fail(1, INT_MAX);
    EXPECT_GT(starved.complaints, 0);
    EXPECT_TRUE(starved.disturbed.inked == starved.disturbed.water);
}
