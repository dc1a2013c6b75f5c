#include "pictures/picture_file.h"

#include <gtest/gtest.h>
#include <stb/stb_image_write.h>

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <fstream>

#include "host/read_file.h"

using namespace std::string_literals;

// A file without a name of its own, which nobody else can have.
static const std::string kPath = "/proc/self/fd/" + std::to_string(fileno(std::tmpfile()));

static std::string reasonAgainst(const std::string& content) {
    std::ofstream(kPath, std::ios::binary) << content;
    std::string error;
    EXPECT_FALSE(loadPicture(kPath, error));
    return error;
}

TEST(PictureFile, ReadsPngAndJpegOfAnyKindAsOpaqueRgba) {
    std::string error;
    const unsigned char rgb[] = {255, 0, 10, 40, 50, 60};
    ASSERT_TRUE(stbi_write_png(kPath.c_str(), 1, 2, 3, rgb, 0));
    const std::optional<Picture> png = loadPicture(kPath, error);
    ASSERT_TRUE(png) << error;
    EXPECT_EQ(std::pair(png->width, png->height), std::pair(1, 2));
    EXPECT_EQ(png->rgba, (std::vector<std::uint8_t>{255, 0, 10, 255, 40, 50, 60, 255}));
    std::filesystem::resize_file(kPath, std::filesystem::file_size(kPath) / 2);
    EXPECT_FALSE(loadPicture(kPath, error));
    EXPECT_NE(error.find(kPath), std::string::npos) << error;

    const std::vector<unsigned char> grey(16 * 16, 100);
    ASSERT_TRUE(stbi_write_jpg(kPath.c_str(), 16, 16, 1, grey.data(), 95));
    const std::optional<Picture> jpeg = loadPicture(kPath, error);
    ASSERT_TRUE(jpeg) << error;
    ASSERT_EQ(jpeg->rgba.size(), 16U * 16 * 4);
    EXPECT_NEAR(jpeg->rgba[2], 100, 2);
    EXPECT_EQ(jpeg->rgba[3], 255);
}

TEST(PictureFile, RefusesWhatWouldHarmTheProcess) {
    const auto png = "\x89PNG\r\n\x1a\n\0\0\0\rIHDR"s;
    EXPECT_NE(reasonAgainst(png + "\0\0\x3e\x80\0\0\x3e\x80\x08\6\0\0\0crc?"s).find("16000x16000"), std::string::npos);
    const std::string reason = reasonAgainst(png + "\0\0\0\1\0\0\0\1\x08\6\0\0\0crc?\0\0\0\0\x1b[7mcrc?"s);
    EXPECT_EQ(reason.find('\x1b'), std::string::npos) << "bytes of the file that a terminal would obey";

    // A pixel in a block of fixed codes: 24 bits of them, then 13 bytes for each 8 runs of 258 zeros, to over a
    // gibibyte.
    std::string zeros = "\x78\1\x63\x18\5"s;
    for (int i = 0; i < 525'000; ++i) zeros += "\xa3\x60\x14\x8c\x82\x51\x30\x0a\x46\xc1\x28\x18\5";
    zeros += "\0\0"s;
    std::string length(4, '\0');
    for (std::size_t i = 0; i < 4; ++i) length[i] = static_cast<char>(zeros.size() >> (24 - 8 * i));
    EXPECT_NE(
        reasonAgainst(png + "\0\0\0\1\0\0\0\1\x08\0\0\0\0crc?"s + length + "IDAT" + zeros + "crc?\0\0\0\0IENDcrc?"s)
            .find("outofmem"),
        std::string::npos);

    // Tables of one code too many, where the file's parts are still told apart, after that, and in a comment.
    const std::string table = "\xff\xc4\1\x14\0\0\0\0\0\0\0\0\1\xff\1\0\0\0\0\0\0"s + std::string(257, 'c');
    EXPECT_NE(reasonAgainst("\xff\xd8\xff\xe0\0\4ab"s + table).find("Huffman"), std::string::npos);
    EXPECT_NE(reasonAgainst("\xff\xd8\xff\xda\0\4abscan"s + table).find("Huffman"), std::string::npos);
    EXPECT_EQ(reasonAgainst("\xff\xd8\xff\xfe\1\x20"s + table + "........").find("Huffman"), std::string::npos);
}

TEST(PictureFile, RefusesMoreScansThanAPictureNeeds) {
    const std::vector<unsigned char> grey(8 * 8, 100);
    ASSERT_TRUE(stbi_write_jpg(kPath.c_str(), 8, 8, 1, grey.data(), 95));
    std::string error;
    const std::string jpeg = readFile(kPath, "", 10000, error).value_or("");
    const std::size_t start = jpeg.find("\xff\xda");
    const std::string scan = jpeg.substr(start, jpeg.size() - 2 - start);
    std::string content = jpeg.substr(0, start);
    for (int i = 0; i < 100; ++i) content += scan;
    std::ofstream(kPath, std::ios::binary) << content + "\xff\xd9";
    EXPECT_TRUE(loadPicture(kPath, error)) << error;
    EXPECT_NE(reasonAgainst(content + scan + "\xff\xd9").find("too many scans"), std::string::npos);
}

TEST(PictureFile, NamesInOneLineEachFileThatOnceDidHarm) {
    for (const auto& file : std::filesystem::directory_iterator(TIDEMARK_REGRESSIONS_PATH)) {
        std::string error;
        EXPECT_FALSE(loadPicture(file.path(), error));
        EXPECT_NE(error.find(file.path()), std::string::npos) << error;
        EXPECT_EQ(error.find('\n'), std::string::npos) << error;
    }
}

TEST(PictureFile, FitsLargePicturesInTheirOwnProportions) {
    Picture wide{40, 10, std::vector<std::uint8_t>(40 * 10 * 4, 7)};
    for (int row = 0; row < 10; ++row) std::fill_n(wide.rgba.begin() + 160 * row, 80, std::uint8_t{200});
    EXPECT_EQ(fitPicture(wide, 40).rgba, wide.rgba);
    const Picture fitted = fitPicture(wide, 20);
    ASSERT_EQ(std::pair(fitted.width, fitted.height), std::pair(20, 5));
    EXPECT_NEAR(fitted.rgba.at(2 * 80 + 2 * 4), 200, 2);
    EXPECT_NEAR(fitted.rgba.at(2 * 80 + 18 * 4), 7, 2);
    const Picture line = fitPicture({1000, 1, std::vector<std::uint8_t>(4000)}, 100);
    EXPECT_EQ(std::pair(line.width, line.height), std::pair(100, 1));
}
