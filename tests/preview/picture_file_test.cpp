#include "preview/picture_file.h"

#include <gtest/gtest.h>
#include <stb/stb_image_write.h>

#include <filesystem>
#include <fstream>

static std::string scratch(const char* name) {
    return (std::filesystem::path(testing::TempDir()) / name).string();
}

TEST(PictureFile, ReadsPngAndJpegOfAnyKindAsOpaqueRgba) {
    const unsigned char rgb[] = {255, 0, 0, 0, 255, 0, 0, 0, 255, 10, 20, 30, 40, 50, 60, 70, 80, 90};
    const std::string png = scratch("rgb.png");
    ASSERT_TRUE(stbi_write_png(png.c_str(), 3, 2, 3, rgb, 9));
    std::string error;
    const std::optional<Picture> read = loadPicture(png, error);
    ASSERT_TRUE(read) << error;
    EXPECT_EQ(read->width, 3);
    EXPECT_EQ(read->height, 2);
    const std::vector<std::uint8_t> expected = {255, 0,  0,  255, 0,  255, 0,  255, 0,  0,  255, 255,
                                                10,  20, 30, 255, 40, 50,  60, 255, 70, 80, 90,  255};
    EXPECT_EQ(read->rgba, expected);

    const std::vector<unsigned char> grey(16 * 16, 100);
    const std::string jpeg = scratch("grey.jpg");
    ASSERT_TRUE(stbi_write_jpg(jpeg.c_str(), 16, 16, 1, grey.data(), 95));
    const std::optional<Picture> greyRead = loadPicture(jpeg, error);
    ASSERT_TRUE(greyRead) << error;
    ASSERT_EQ(greyRead->rgba.size(), 16U * 16 * 4);
    EXPECT_NEAR(greyRead->rgba[0], 100, 2);
    EXPECT_NEAR(greyRead->rgba[2], 100, 2);
    EXPECT_EQ(greyRead->rgba[3], 255);

    // Half a file is no picture.
    std::filesystem::resize_file(png, std::filesystem::file_size(png) / 2);
    EXPECT_FALSE(loadPicture(png, error));
    EXPECT_NE(error.find(png), std::string::npos) << error;
}

static std::string reasonAgainst(const std::string& content) {
    const std::string path = scratch("bad");
    std::ofstream(path, std::ios::binary) << content;
    std::string error;
    EXPECT_FALSE(loadPicture(path, error));
    return error;
}

TEST(PictureFile, RefusesWhatWouldHarmTheProcess) {
    using namespace std::string_literals;
    const auto png = "\x89PNG\r\n\x1a\n\0\0\0\rIHDR"s;
    const auto huge = "\0\0\x3e\x80\0\0\x3e\x80\x08\6\0\0\0crc?"s;
    EXPECT_NE(reasonAgainst(png + huge).find("16000x16000"), std::string::npos);

    const auto small = "\0\0\0\1\0\0\0\1\x08\6\0\0\0crc?"s;
    const std::string reason = reasonAgainst(png + small + "\0\0\0\0\x1b[7mcrc?"s);
    EXPECT_EQ(reason.find('\x1b'), std::string::npos) << "bytes of the file that a terminal would obey";

    // Tables of one code too many, where the file's parts are still told apart and after that.
    const std::string codes(257, 'c');
    const auto counts = "\0\0\0\0\0\0\0\1\xff\1\0\0\0\0\0\0"s;
    const auto table = "\xff\xc4\1\x14\0"s + counts + codes;
    EXPECT_NE(reasonAgainst("\xff\xd8\xff\xe0\0\4ab"s + table).find("Huffman"), std::string::npos);
    EXPECT_NE(reasonAgainst("\xff\xd8\xff\xda\0\4abscan"s + table).find("Huffman"), std::string::npos);
    // Inside a comment, where nobody reads it as a table.
    EXPECT_EQ(reasonAgainst("\xff\xd8\xff\xfe\1\x20"s + table + "........"s).find("Huffman"), std::string::npos);
}

TEST(PictureFile, SaysInOneLineWhatIsWrongWithAFileThatOnceDidHarm) {
    for (const auto& file : std::filesystem::directory_iterator(TIDEMARK_REGRESSIONS_PATH)) {
        std::string error;
        EXPECT_FALSE(loadPicture(file.path(), error));
        EXPECT_NE(error.find(file.path()), std::string::npos) << error;
        EXPECT_EQ(error.find('\n'), std::string::npos) << error;
    }
}

TEST(PictureFile, FitsLargePicturesInTheirOwnProportions) {
    Picture wide{400, 100, {}};
    for (int i = 0; i < 400 * 100; ++i) {
        const bool left = i % 400 < 200;
        wide.rgba.insert(
            wide.rgba.end(),
            {static_cast<std::uint8_t>(left ? 200 : 10), 50, static_cast<std::uint8_t>(left ? 10 : 200), 255});
    }
    EXPECT_EQ(fitPicture(wide, 400).rgba, wide.rgba);
    const Picture fitted = fitPicture(wide, 200);
    ASSERT_EQ(fitted.width, 200);
    ASSERT_EQ(fitted.height, 50);
    ASSERT_EQ(fitted.rgba.size(), 200U * 50 * 4);
    const std::size_t middleRow = 25 * 200 * 4;
    EXPECT_NEAR(fitted.rgba[middleRow + 20 * 4], 200, 2);
    EXPECT_NEAR(fitted.rgba[middleRow + 180 * 4], 10, 2);
    EXPECT_NEAR(fitted.rgba[middleRow + 180 * 4 + 2], 200, 2);

    const Picture line = fitPicture({1000, 1, std::vector<std::uint8_t>(4000, 7)}, 100);
    EXPECT_EQ(line.width, 100);
    EXPECT_EQ(line.height, 1);
}
