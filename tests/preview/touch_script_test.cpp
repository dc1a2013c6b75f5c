#include "preview/touch_script.h"

#include <gtest/gtest.h>

#include <sstream>

using namespace tidemark;

static std::optional<std::vector<TouchEvent>> parse(const std::string& text, std::string& error) {
    std::istringstream stream(text);
    return parseTouchScript(stream, "a.touch", error);
}

TEST(TouchScript, ReadsEventsBetweenCommentsAndBlankLines) {
    std::string error;
    const auto events =
        parse("# a\n\n0 down -3 20 1\r\n  16\tmove 100% 12.5% 0.5 # b\n16 up 0 7 0\n17 cancel 0 0 1", error);
    ASSERT_TRUE(events) << error;
    EXPECT_EQ(
        writeTouchScript(*events),
        "# time_ms action x y pressure\n0 down -3.000 20.000 1.00\n16 move 100.000% 12.500% 0.50\n"
        "16 up 0.000 7.000 0.00\n17 cancel 0.000 0.000 1.00\n");
    std::ostringstream read;
    for (const auto& [timeMs, action, x, y, pressure] : *events) {
        read << timeMs << " " << static_cast<int>(action) << " " << x.pixels(1080) << "," << y.pixels(1920) << " "
             << pressure << "; ";
    }
    EXPECT_EQ(read.str(), "0 0 -3,20 1; 16 2 1080,240 0.5; 16 1 0,7 0; 17 3 0,0 1; ");
}

TEST(TouchScript, NamesTheLineThatIsWrong) {
    for (const auto& [line, reason] :
         {std::pair{"100 down 1 1", "expected"},
          {"100 down 1 1 1 1", "expected"},
          {"100 \x1b[7m 1 1 1", R"(action "\x1b[7m")"},
          {"-1 down 1 1 1", "time"},
          {"3600001 down 1 1 1", "time"},
          {"99 down 1 1 1", "before"},
          {"100 down 1 5%% 1", "position \"5%%\""},
          {"100 down nan 1 1", "position"},
          {"100 down 1 1e30 1", "position"},
          {"100 down 1 1 -1", "pressure"},
          {"100 down 1 1 nan", "pressure"},
          {"100 down 1 1 11", "pressure"}}) {
        std::string error;
        EXPECT_FALSE(parse("# first\n100 down 1 1 1\n\n" + std::string(line) + "\n200 up 1 1 1\n", error)) << line;
        EXPECT_EQ(error.rfind("a.touch:4: ", 0), 0U) << error;
        EXPECT_NE(error.find(reason), std::string::npos) << error;
    }
}
