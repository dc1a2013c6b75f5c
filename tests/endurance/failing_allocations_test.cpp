// Each of the library's allocations fails once. A buffer that only grows is allocated once in a process, so every
// failure gets a process of its own, made before there is a GL context.
#include <GLES2/gl2.h>
#include <gtest/gtest.h>
#include <sys/mman.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "gl/shader_program.h"
#include "host/native_names.h"
#include "host/water_host.h"
#include "platform/desktop_bitmap.h"
#include "platform/headless_context.h"
#include "tests/support/library_blocks.h"
#include "tests/support/log_recorder.h"
#include "tests/support/test_pictures.h"

namespace {

constexpr int kWidth = 252;
constexpr int kHeight = 240;
using Frame = std::array<std::uint8_t, kWidth * kHeight * 4>;

enum Stage { kFirst, kLarger, kRecovered, kStages };
constexpr int kPictures = 3;

// What a session was like, in memory that the process which ran it shares with the one that judges it.
struct Outcome {
    int requests;                              // until the recovery
    int handOverRequest[kStages * kPictures];  // the number of each hand-over's request
    int complaints;                            // about missing memory
    char complaint[64];
    int shaderErrors;  // texts of the driver that were logged
    Frame inked[kStages];
    Frame cleared[kStages];
};

enum class Complaint { none, bitmap, grid, upload, smoothing };

Complaint kindOf(const Outcome& outcome) {
    const std::string_view text = outcome.complaint;
    if (text.starts_with("E cannot copy a bitmap")) return Complaint::bitmap;
    if (text.starts_with("E no memory for an ink grid")) return Complaint::grid;
    if (text == "E no memory for uploading the ink's velocity") return Complaint::upload;
    if (text == "E no memory for smoothing the water") return Complaint::smoothing;
    return Complaint::none;
}

void read(Frame& frame) {
    glReadPixels(0, 0, kWidth, kHeight, GL_RGBA, GL_UNSIGNED_BYTE, frame.data());
}

void note(Outcome& outcome, const std::vector<std::string>& lines) {
    for (const std::string& line : lines) {
        if (line.starts_with("E Could not")) ++outcome.shaderErrors;
        if (!line.starts_with("E no memory") && !line.starts_with("E cannot")) continue;
        ++outcome.complaints;
        std::snprintf(outcome.complaint, sizeof outcome.complaint, "%s", line.c_str());
    }
}

class Session {
public:
    // Leaves the hand-over of that number out, if any.
    Session(Outcome& outcome, int omittedHandOver) : outcome_(outcome), omitted_(omittedHandOver) {}

    void run() {
        Look look;
        look.meshVertices = 32;
        play(kFirst, look, 168, 240);
        buildBrokenShaders();
        // A larger view and a larger mesh: every buffer has to grow.
        look.meshVertices = 40;
        play(kLarger, look, kWidth, 204);
        outcome_.requests = LibraryBlocks::requested;
        LibraryBlocks::failLast = 0;
        note(outcome_, log_.take());
        play(kRecovered, look, 168, 240);
        note(outcome_, log_.take());
    }

private:
    void handOver(Stage stage) {
        void (*const transfers[kPictures])(JNIEnv*, jobject, jobject) = {
            NATIVE(transferPortraitBGBitmap), NATIVE(transferLandscapeBGBitmap), NATIVE(transferWaterBitmap)};
        for (int i = 0; i < kPictures; ++i) {
            const int number = stage * kPictures + i;
            outcome_.handOverRequest[number] = LibraryBlocks::requested + 1;
            if (number == omitted_) continue;
            Picture picture = smoothPicture(20 + 4 * stage, 30, number);
            DesktopBitmap bitmap;
            bitmap.info.width = static_cast<std::uint32_t>(picture.width);
            bitmap.info.height = static_cast<std::uint32_t>(picture.height);
            bitmap.pixels = picture.rgba.data();
            transfers[i](hostEnvironment(), nullptr, &bitmap);
        }
    }

    // Every kind of touch.
    void play(Stage stage, const Look& look, int width, int height) {
        handOver(stage);
        WaterHost host(look, width, height, 1);
        glClear(GL_COLOR_BUFFER_BIT);
        host.setUp(true);
        srand48(1);
        int x = 70;
        const int y = 100;
        const auto move = [&](int way) {
            x += way;
            host.touch(TouchAction::move, x, y, 1.0f);
            host.advance(1.0 / 60);
            host.draw();
        };
        host.touch(TouchAction::down, x, y, 1.0f);
        move(15);
        host.touch(TouchAction::cancel, x, y, 1.0f);
        host.touch(TouchAction::down, x, y, 1.0f);
        for (const int way : {1, 0, 12, 12, 6, 1}) move(way);
        host.touch(TouchAction::up, x, y, 1.0f);
        host.draw();
        read(outcome_.inked[stage]);
        host.clearInk();
        host.draw();
        read(outcome_.cleared[stage]);
    }

    // A driver that refuses the shaders explains it in texts of its own length.
    static void buildBrokenShaders() {
        zorloadShaderScript(GL_VERTEX_SHADER, "void main( {");
        const GLuint vertex = zorloadShaderScript(GL_VERTEX_SHADER, "void main() { gl_Position = vec4(0.0); }");
        const GLuint fragment = zorloadShaderScript(
            GL_FRAGMENT_SHADER, "varying mediump vec4 missing; void main() { gl_FragColor = missing; }");
        zorCreateShaderProgram(vertex, fragment);
    }

    Outcome& outcome_;
    const int omitted_;
    LogRecorder log_;
};

struct Unmapping {
    void operator()(Outcome* outcome) const { munmap(outcome, sizeof *outcome); }
};
using Shared = std::unique_ptr<Outcome, Unmapping>;

// One session in a process of its own, in which the requests failFirst to failLast fail.
Shared sessionOf(int failFirst, int failLast, int omittedHandOver) {
    Shared outcome(static_cast<Outcome*>(
        mmap(nullptr, sizeof(Outcome), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0)));
    std::fflush(nullptr);
    const pid_t child = fork();
    if (child == 0) {
        {
            std::string error;
            const auto context = HeadlessContext::create(kWidth, kHeight, error);
            if (!context) std::exit(2);
            LibraryBlocks::requested = 0;
            LibraryBlocks::failFirst = failFirst;
            LibraryBlocks::failLast = failLast;
            Session(*outcome, omittedHandOver).run();
        }
        std::exit(0);
    }
    int status = -1;
    waitpid(child, &status, 0);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << "status " << status;
    return outcome;
}

Shared sessionFailing(int request) {
    return sessionOf(request, request, -1);
}

// Spares a failure's message two whole frames.
bool same(const Frame& a, const Frame& b) {
    return a == b;
}

double meanDifference(const Frame& a, const Frame& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.size(); ++i) sum += std::abs(a[i] - b[i]);
    return sum / static_cast<double>(a.size());
}

}  // namespace

TEST(FailingAllocations, costWhatTheyAreForAndTheNextSetUpRecovers) {
    const Shared undisturbed = sessionOf(0, 0, -1);
    ASSERT_EQ(undisturbed->complaints, 0);
    ASSERT_EQ(undisturbed->shaderErrors, 2);
    for (int stage = 0; stage < kStages; ++stage) {
        ASSERT_FALSE(same(undisturbed->inked[stage], undisturbed->cleared[stage])) << "ink is seen";
    }
    std::array<int, 5> seen = {};
    for (int request = 1; request <= undisturbed->requests; ++request) {
        SCOPED_TRACE(request);
        const Shared outcome = sessionFailing(request);
        SCOPED_TRACE(outcome->complaint);
        const Complaint complaint = kindOf(*outcome);
        ++seen[static_cast<std::size_t>(complaint)];
        EXPECT_EQ(outcome->complaints, complaint != Complaint::none);
        EXPECT_EQ(outcome->shaderErrors, complaint == Complaint::none ? 1 : 2);
        EXPECT_TRUE(same(outcome->inked[kRecovered], undisturbed->inked[kRecovered]));
        EXPECT_TRUE(same(outcome->cleared[kRecovered], undisturbed->cleared[kRecovered]));

        if (complaint == Complaint::bitmap) {
            const auto* const failed = std::ranges::find(undisturbed->handOverRequest, request);
            const Shared without = sessionOf(0, 0, static_cast<int>(failed - undisturbed->handOverRequest));
            for (const Stage stage : {kFirst, kLarger}) {
                EXPECT_TRUE(same(outcome->inked[stage], without->inked[stage]));
                EXPECT_TRUE(same(outcome->cleared[stage], without->cleared[stage]));
            }
            continue;
        }
        int stagesWithoutInk = 0;
        for (const Stage stage : {kFirst, kLarger}) {
            SCOPED_TRACE(stage);
            stagesWithoutInk += same(outcome->inked[stage], outcome->cleared[stage]);
            if (complaint == Complaint::smoothing) {
                // One step of the waves is a little rougher.
                EXPECT_LT(meanDifference(outcome->cleared[stage], undisturbed->cleared[stage]), 0.5);
            } else {
                EXPECT_TRUE(same(outcome->cleared[stage], undisturbed->cleared[stage])) << "the water as ever";
            }
        }
        EXPECT_EQ(stagesWithoutInk, complaint == Complaint::grid);
    }
    std::printf(
        "%d requests failed in turn: %d for pictures, %d for grids, %d for uploads, %d for smoothing, %d for texts\n",
        undisturbed->requests, seen[1], seen[2], seen[3], seen[4], seen[0]);
    // Three pictures and five fields, both twice; both buffers begun and grown; two texts.
    EXPECT_EQ(seen, (std::array{2, 6, 10, 2, 2}));
}

TEST(FailingAllocations, aTimeWithoutAnyMemoryIsSurvived) {
    const Shared undisturbed = sessionOf(0, 0, -1);
    const Shared outcome = sessionOf(1, 1 << 30, -1);
    EXPECT_GT(outcome->complaints, 0);
    EXPECT_TRUE(same(outcome->inked[kFirst], outcome->cleared[kFirst]));
    EXPECT_TRUE(same(outcome->inked[kRecovered], undisturbed->inked[kRecovered]));
    EXPECT_TRUE(same(outcome->cleared[kRecovered], undisturbed->cleared[kRecovered]));
}
