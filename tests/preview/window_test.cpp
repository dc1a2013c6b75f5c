// The window as a user has it, on an X server without a screen: mouse and keys in, what the server shows out.
#include <gtest/gtest.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>
#include <thread>
#include <vector>

namespace {

constexpr int kWidth = 240;
constexpr int kHeight = 320;

using Bytes = std::vector<unsigned char>;

struct Spot {
    int x, y, side;
};
constexpr Spot kEndOfStroke = {168, 148, 24};

class Window : public testing::Test {
protected:
    void SetUp() override {
        start({"--size", std::to_string(kWidth) + "x" + std::to_string(kHeight)});
        ASSERT_TRUE(waitUntil([] { return brightness(grab(kWidth, kHeight)) > 20; })) << "no picture";
        send("mousemove 20 20");  // keys go where the mouse is
    }
    void TearDown() override {
        if (process_ > 0) kill(process_, SIGKILL);
        if (process_ > 0) waitpid(process_, nullptr, 0);
        ASSERT_TRUE(waitUntil([] { return brightness(grab(kWidth, kHeight)) < 1; })) << "the window is still there";
    }

    void start(std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), {TIDEMARK_PREVIEW_PATH, "--window"});
        std::vector<char*> argv;
        for (std::string& argument : arguments) argv.push_back(argument.data());
        argv.push_back(nullptr);
        ASSERT_EQ(posix_spawn(&process_, argv[0], nullptr, nullptr, argv.data(), environ), 0);
    }

    static void send(const std::string& events) {
        ASSERT_EQ(std::system(("xdotool " + events + " >/dev/null").c_str()), 0) << events;
    }

    // What the server shows from its upper left corner on, where the window stands.
    static Bytes grab(int width, int height) {
        const std::string size = std::to_string(width) + "x" + std::to_string(height);
        const std::string command = "ffmpeg -v error -f x11grab -draw_mouse 0 -video_size " + size +
                                    " -i $DISPLAY -frames:v 1 -f rawvideo -pix_fmt rgb24 -";
        std::FILE* const pipe = popen(command.c_str(), "r");
        Bytes bytes(3 * static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
        bytes.resize(std::fread(bytes.data(), 1, bytes.size(), pipe));
        pclose(pipe);
        return bytes;
    }

    static double brightness(const Bytes& picture) {
        double sum = 0;
        for (const unsigned char byte : picture) sum += byte;
        return sum / static_cast<double>(picture.size());
    }

    // How much darker the red of a spot has become on average.
    static double darkening(const Bytes& before, const Bytes& after, Spot spot) {
        double sum = 0;
        for (int y = spot.y; y < spot.y + spot.side; ++y) {
            for (int x = spot.x; x < spot.x + spot.side; ++x) {
                const auto i = static_cast<std::size_t>(3 * (y * kWidth + x));
                sum += before[i] - after[i];
            }
        }
        return sum / (spot.side * spot.side);
    }

    static double difference(const Bytes& a, const Bytes& b) {
        double sum = 0;
        for (std::size_t i = 0; i < a.size(); ++i) sum += std::abs(a[i] - b[i]);
        return sum / static_cast<double>(a.size());
    }

    template <class Condition>
    static bool waitUntil(Condition condition) {
        for (int i = 0; i < 300; ++i) {
            if (condition()) return true;
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
        }
        return false;
    }

    // Processor time that the program has taken, in the system's ticks.
    long ticks() const {
        std::ifstream file("/proc/" + std::to_string(process_) + "/stat");
        std::string field;
        for (int i = 0; i < 13; ++i) file >> field;
        long user = 0, system = 0;
        file >> user >> system;
        return user + system;
    }

    bool rests() const {
        return waitUntil([this] {
            const long before = ticks();
            std::this_thread::sleep_for(std::chrono::milliseconds(400));
            return ticks() == before;
        });
    }

    // The button stays down, so that ink goes on flowing at the end of the stroke.
    static void stroke() {
        send("mousemove 60 160 mousedown 1");
        for (int x = 60; x <= 180; x += 10) send("mousemove " + std::to_string(x) + " 160 sleep 0.02");
    }

    pid_t process_ = -1;
};

}  // namespace

TEST_F(Window, DrawsWithInkUntilThatIsClearedAndThenRests) {
    ASSERT_TRUE(rests());
    const Bytes still = grab(kWidth, kHeight);
    stroke();
    EXPECT_TRUE(waitUntil([&] { return darkening(still, grab(kWidth, kHeight), kEndOfStroke) > 25; }));
    send("key c");
    EXPECT_TRUE(waitUntil([&] { return darkening(still, grab(kWidth, kHeight), kEndOfStroke) < 8; })) << "not cleared";
    send("mouseup 1");
    EXPECT_TRUE(rests());
    EXPECT_LT(difference(still, grab(kWidth, kHeight)), 1.5);
}

TEST_F(Window, KeysSwitchInkAndRainAndClose) {
    ASSERT_TRUE(rests());
    const Bytes still = grab(kWidth, kHeight);
    send("key i");
    stroke();
    EXPECT_FALSE(darkening(still, grab(kWidth, kHeight), kEndOfStroke) > 25) << "there is ink";
    send("mouseup 1 key r");
    EXPECT_TRUE(waitUntil([&] { return difference(still, grab(kWidth, kHeight)) > 1.5; })) << "no rain";
    send("key r");
    EXPECT_TRUE(rests()) << "rain goes on";

    send("key Escape");
    int status = -1;
    ASSERT_EQ(waitpid(process_, &status, 0), process_);
    process_ = -1;
    EXPECT_EQ(WIFEXITED(status) ? WEXITSTATUS(status) : -1, 0);
}

TEST_F(Window, FillsAnotherSize) {
    ASSERT_TRUE(rests());
    send("search --name Tidemark windowsize 400 200");
    EXPECT_TRUE(waitUntil([&] {
        const Bytes wide = grab(400, 200);
        double right = 0;
        for (std::size_t row = 0; row < 200; ++row) right += wide[3 * (400 * row + 390) + 1];
        return right / 200 > 20;
    })) << "the new part stays dark";
    EXPECT_TRUE(rests());
}
