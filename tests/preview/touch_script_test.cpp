#include "preview/touch_script.h"

#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <sstream>

static std::optional<std::vector<TouchEvent>> parse(const std::string& text, std::string& error) {
    std::istringstream stream(text);
    return parseTouchScript(stream, "a.touch", error);
}

TEST(TouchScript, ReadsEventsBetweenCommentsAndBlankLines) {
    std::string error;
    const auto events =
        parse("# a stroke\n\n0 down 10 20 1\r\n  16\tmove 50% 12.5% 0.5 # half\n16 up -3 7 0\n17 cancel 0 0 1", error);
    ASSERT_TRUE(events) << error;
    ASSERT_EQ(events->size(), 4U);
    const TouchEvent& move = (*events)[1];
    EXPECT_EQ(move.timeMs, 16);
    EXPECT_EQ(move.action, TouchAction::move);
    EXPECT_EQ(move.x.pixels(1080), 540);
    EXPECT_EQ(move.y.pixels(1920), 240);
    EXPECT_EQ(move.pressure, 0.5f);
    EXPECT_EQ((*events)[0].y.pixels(1920), 20);
    EXPECT_EQ((*events)[2].x.pixels(1080), -3);
    EXPECT_EQ((*events)[2].action, TouchAction::up);
    EXPECT_EQ((*events)[3].action, TouchAction::cancel);
    EXPECT_TRUE(parse("", error)->empty());
}

TEST(TouchScript, NamesTheLineThatIsWrong) {
    const struct {
        const char* line;
        const char* reason;
    } cases[] = {
        {"100 down 1 1", "expected"},
        {"100 down 1 1 1 1", "expected"},
        {"100 tap 1 1 1", "action"},
        {"100 Down 1 1 1", "action"},
        {"-1 down 1 1 1", "time"},
        {"1.5 down 1 1 1", "time"},
        {"99 down 1 1 1", "before"},
        {"99999999999999999999 down 1 1 1", "time"},
        {"100 down a 1 1", "position \"a\""},
        {"100 down 1 5%% 1", "position \"5%%\""},
        {"100 down 1 % 1", "position \"%\""},
        {"100 down nan 1 1", "position"},
        {"100 down 1 1e30 1", "position"},
        {"100 down 1 1 hard", "pressure"},
        {"100 down 1 1 -1", "pressure"},
        {"100 down 1 1 nan", "pressure"},
        {"100 down 1 1 inf", "pressure"},
    };
    for (const auto& bad : cases) {
        std::string error;
        EXPECT_FALSE(parse("# first\n100 down 1 1 1\n\n" + std::string(bad.line) + "\n200 up 1 1 1\n", error))
            << bad.line;
        EXPECT_EQ(error.rfind("a.touch:4: ", 0), 0U) << error;
        EXPECT_NE(error.find(bad.reason), std::string::npos) << error;
        EXPECT_EQ(error.find('\n'), std::string::npos) << error;
    }
}

// Pixels between successive moves on a 1080x1920 view: shortest and longest.
static std::pair<double, double> speeds(const std::vector<TouchEvent>& events) {
    double shortest = 1.0e9, longest = 0.0;
    for (std::size_t i = 1; i < events.size(); ++i) {
        if (events[i].action != TouchAction::move) continue;
        const double distance = std::hypot(
            events[i].x.pixels(1080) - events[i - 1].x.pixels(1080),
            events[i].y.pixels(1920) - events[i - 1].y.pixels(1920));
        shortest = std::min(shortest, distance);
        longest = std::max(longest, distance);
    }
    return {shortest, longest};
}

TEST(TouchScript, ShippedScenesAreWholeGesturesInsideTheView) {
    int scenes = 0;
    for (const auto& entry : std::filesystem::directory_iterator(TIDEMARK_SCENES_PATH)) {
        std::string error;
        const auto events = loadTouchScript(entry.path().string(), error);
        ASSERT_TRUE(events) << error;
        bool down = false;
        for (const TouchEvent& event : *events) {
            EXPECT_EQ(event.action == TouchAction::down, !down) << entry.path() << " at " << event.timeMs;
            down = event.action == TouchAction::down || event.action == TouchAction::move;
            const int x = event.x.pixels(1080), y = event.y.pixels(1920);
            EXPECT_TRUE(x >= 0 && x < 1080 && y >= 0 && y < 1920) << entry.path() << " at " << event.timeMs;
        }
        EXPECT_FALSE(down) << entry.path();
        const auto [shortest, longest] = speeds(*events);
        const std::string name = entry.path().stem().string();
        if (name == "slow") {
            EXPECT_LE(longest, 2.0);
        } else if (name == "medium") {
            EXPECT_TRUE(shortest > 2.0 && longest <= 10.0) << shortest << " to " << longest;
        } else if (name == "fast") {
            EXPECT_GT(shortest, 10.0);
        }
        ++scenes;
    }
    EXPECT_GE(scenes, 9);
}
