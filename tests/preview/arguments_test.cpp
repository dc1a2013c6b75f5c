#include "preview/arguments.h"

#include <gtest/gtest.h>

TEST(Arguments, ReadsSizesAndRefusesAllElse) {
    std::string error;
    const std::optional<Size> size = parseSize("1080x1920", error);
    ASSERT_TRUE(size);
    EXPECT_EQ(size->width, 1080);
    EXPECT_EQ(size->height, 1920);
    EXPECT_TRUE(parseSize("1x8192", error));
    for (const char* bad :
         {"", "x", "10", "10x", "x10", "0x10", "10x0", "-1x10", "10x8193", "10x10x10", "10 x10", "axb",
          "99999999999x10", "10x1.5", "0x1F"}) {
        EXPECT_FALSE(parseSize(bad, error)) << bad;
    }
}

TEST(Arguments, ReadsInkColorsThatTheInkCanShow) {
    std::string error;
    const std::optional<InkColor> colour = parseInkColor("#336699", error);
    ASSERT_TRUE(colour);
    EXPECT_FLOAT_EQ(colour->red, 0.2f);
    EXPECT_FLOAT_EQ(colour->green, 0.4f);
    EXPECT_FLOAT_EQ(colour->blue, 0.6f);
    const std::optional<InkColor> extremes = parseInkColor("#00FFff", error);
    ASSERT_TRUE(extremes);
    EXPECT_EQ(extremes->red, 0.0f);
    EXPECT_LE(extremes->green, 0.75f);
    EXPECT_EQ(extremes->green, extremes->blue);
    for (const char* bad :
         {"", "#", "336699", "#33669", "#3366999", "#33669g", "#-13-13", "# 33669", "#+1+1+1", "red"}) {
        EXPECT_FALSE(parseInkColor(bad, error)) << bad;
    }
}
