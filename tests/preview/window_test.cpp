// The window on an X server without a screen: sends mouse and key events and reads the server's pixels.
#include <chrono>
#include <fstream>
#include <functional>
#include <future>
#include <thread>

#include "tests/preview/program.h"

class Window : public Program {
protected:
    static void send(const std::string& events) { EXPECT_EQ(run("xdotool " + events), "0\n") << events; }

    // The button stays down, so that ink continues to flow at the end of the stroke.
    static void stroke() {
        std::string events = "mousemove 30 80 mousedown 1";
        for (int x = 35; x <= 90; x += 5) events += " sleep 0.02 mousemove " + std::to_string(x) + " 80";
        send(events);
    }

    // Reads a rectangle of the screen; the window is in the upper left corner.
    static std::string grab(const std::string& size, const std::string& place, const std::string& filter) {
        return run(
            "ffmpeg -v error -fpsprobesize 0 -f x11grab -draw_mouse 0 -video_size " + size + " -i $DISPLAY+" + place +
            " -frames:v 1 -vf " + filter + " -f rawvideo -pix_fmt rgb24 -");
    }
    static int averageRed(const std::string& size, const std::string& place) {
        return static_cast<unsigned char>(grab(size, place, "scale=1:1:flags=area")[0]);
    }
    static int redAtEndOfStroke() { return averageRed("12x12", "84,74"); }
    static bool still() {
        const std::string shown = grab("120x160", "0,0", "null");
        std::this_thread::sleep_for(std::chrono::milliseconds(300));
        return grab("120x160", "0,0", "null") == shown;
    }

    static bool waitUntil(const std::function<bool()>& condition) {
        const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(20);
        while (std::chrono::steady_clock::now() < end) {
            if (condition()) return true;
        }
        return false;
    }

    // A failed assertion leaves the window open.
    void TearDown() override {
        if (program.valid()) {
            send("key Escape");
            program.wait();
        }
        Program::TearDown();
    }

    std::future<std::string> program;
};

TEST_F(Window, ObeysMouseAndKeysAndFillsAnotherSize) {
    // The water calms immediately, the picture has its own colours, and rain has no pauses.
    std::ofstream("../look") << "damping = 0.8\nbreeze = 0\nwet = 0\nrainDropsPerSecond = 60\nframesToFade = 30\n";
    run("ffmpeg -v error -f lavfi -i color=red:size=20x10 -frames:v 1 ../red.png");
    program = std::async(
        [] { return preview("--window --size 120x160 --look ../look --picture ../red.png --record a.touch"); });
    ASSERT_TRUE(waitUntil([] { return redAtEndOfStroke() > 20 && still(); })) << "no picture";
    const int red = redAtEndOfStroke();
    stroke();
    ASSERT_TRUE(waitUntil([=] { return redAtEndOfStroke() < red - 25; })) << "no ink";
    send("key c");
    ASSERT_TRUE(waitUntil([=] { return redAtEndOfStroke() > red - 8; })) << "not cleared";
    send("mouseup 1 key i");
    stroke();
    bool inky = false;
    ASSERT_TRUE(waitUntil([&] { return (inky |= redAtEndOfStroke() < red - 25) || still(); }));
    ASSERT_FALSE(inky) << "ink though it is switched off";

    send("mouseup 1 key r");
    ASSERT_TRUE(waitUntil([] { return !still(); })) << "no rain";
    send("key r");
    ASSERT_TRUE(waitUntil(still)) << "rain goes on";
    send("search --name Tidemark windowsize 200 100");
    ASSERT_TRUE(waitUntil([] { return averageRed("10x90", "185,5") > 200; })) << "the new part has no picture";
    send("key Escape");
    const std::string output = program.get();
    EXPECT_TRUE(output.starts_with("Wrote ") && output.ends_with("\n0\n")) << output;
    EXPECT_EQ(run("grep -c -e down -e up a.touch"), "4\n0\n");
    EXPECT_EQ(run("sed -n 2p a.touch"), "200 down 25.000% 50.000% 1.00\n0\n");
}
