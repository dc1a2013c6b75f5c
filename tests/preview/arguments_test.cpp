#include "preview/arguments.h"

#include <gtest/gtest.h>

TEST(Arguments, ReadsSizesAndRefusesAllElse) {
    std::string error;
    const std::optional<Size> size = parseSize("1x8192", error);
    ASSERT_TRUE(size);
    EXPECT_EQ(std::pair(size->width, size->height), std::pair(1, 8192));
    for (const char* bad : {"", "10", "x10", "0x10", "-1x10", "10x8193", "10x10x10", "10 x10", "99999999999x10"})
        EXPECT_FALSE(parseSize(bad, error)) << bad;
}

TEST(Arguments, ReadsInkColorsThatTheInkCanShow) {
    std::string error;
    const std::optional<InkColor> color = parseInkColor("#3366Ff", error);
    ASSERT_TRUE(color);
    EXPECT_FLOAT_EQ(color->red, 0.2f);
    EXPECT_FLOAT_EQ(color->green, 0.4f);
    EXPECT_EQ(color->blue, 0.75f);
    for (const char* bad : {"", "#", "0336699", "#33669", "#3366999", "#33669g", "#-1-1-1", "#+1+1+1"})
        EXPECT_FALSE(parseInkColor(bad, error)) << bad;
}
