#include "preview/picture_file.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "host/read_file.h"

using namespace tidemark;

using namespace std::string_literals;

class PictureFile : public testing::Test {
protected:
    void SetUp() override {
        std::filesystem::create_directories(folder_);
        std::filesystem::current_path(folder_);
    }
    void TearDown() override {
        std::filesystem::current_path("/");
        std::filesystem::remove_all(folder_);
    }

    static void make(const std::string& name, const std::string& filter) {
        const std::string source = "color=red:size=16x8:duration=1,format=yuv444p," + filter;
        const std::string made = "made" + std::string(std::filesystem::path(name).extension());
        ASSERT_EQ(std::system(("ffmpeg -v error -f lavfi -i '" + source + "' -frames:v 1 " + made).c_str()), 0);
        std::filesystem::rename(made, name);
    }
    static void write(const std::string& name, const std::string& content) {
        std::ofstream(name, std::ios::binary) << content;
    }
    static Picture load(const std::string& name) {
        std::string error;
        const std::optional<Picture> picture = loadPicture(name, error);
        EXPECT_TRUE(picture) << error;
        return picture.value_or(Picture{1, 1, {0, 0, 0, 0}});
    }
    static void expectColor(const Picture& picture, int x, int y, std::array<int, 4> color) {
        for (std::size_t i = 0; i < 4; ++i) {
            const std::size_t place = 4 * static_cast<std::size_t>(y * picture.width + x) + i;
            EXPECT_NEAR(picture.rgba.at(place), color.at(i), 6) << x << "," << y << " channel " << i;
        }
    }

private:
    const std::filesystem::path folder_ = testing::TempDir() + "pictures-" + std::to_string(getpid());
};

constexpr std::array<int, 4> kRed = {253, 0, 0, 255}, kBlue = {0, 0, 253, 255};

TEST_F(PictureFile, ReadsPicturesOfManyKinds) {
    for (const std::string name : {"%d.png", "[a]*?.jpg", "a:b.webp", "a.gif", "a.avif"}) {
        make(name, "drawbox=x=8:w=8:h=8:color=blue:t=fill");
        const Picture picture = load(name);
        ASSERT_EQ(std::pair(picture.width, picture.height), std::pair(16, 8)) << name;
        expectColor(picture, 2, 4, kRed);
        expectColor(picture, 13, 4, kBlue);
    }
}

TEST_F(PictureFile, TurnsAPhotoAsTheCameraWasHeld) {
    make("a.jpg", "drawbox=x=8:w=8:h=8:color=blue:t=fill");
    std::string error, photo = readFile("a.jpg", "", 10000, error).value_or("");
    // EXIF orientation 6: the picture must be rotated clockwise.
    photo.insert(2, "\xff\xe1\0\x22"s + "Exif\0\0MM\0*\0\0\0\x08\0\1\1\x12\0\3\0\0\0\1\0\6\0\0\0\0\0\0"s);
    write("turned.jpg", photo);
    const Picture picture = load("turned.jpg");
    ASSERT_EQ(std::pair(picture.width, picture.height), std::pair(8, 16));
    expectColor(picture, 4, 2, kRed);
    expectColor(picture, 4, 13, kBlue);
}

TEST_F(PictureFile, ShowsWhiteWhereAPictureIsTransparent) {
    make("a.png", "format=rgba,colorchannelmixer=aa=0.5");
    expectColor(load("a.png"), 3, 3, {254, 127, 127, 255});
}

TEST_F(PictureFile, WritesWhatItReads) {
    Picture picture{3, 2, {}};
    for (int i = 0; i < 24; ++i) picture.rgba.push_back(static_cast<std::uint8_t>(i % 4 == 3 ? 255 : 37 * i));
    std::string error;
    ASSERT_TRUE(savePicture(picture, "a:b.png", error)) << error;
    EXPECT_EQ(load("a:b.png").rgba, picture.rgba);
    EXPECT_FALSE(savePicture(picture, "no/a.png", error));
    EXPECT_NE(error.find("No such file"), error.npos) << error;
}

TEST_F(PictureFile, RefusesInOneLineWhatIsNoPictureOrTooLarge) {
    make("a.png", "null");
    std::string ignored;
    write("half.png", readFile("a.png", "", 10000, ignored).value_or("").substr(0, 60));
    write("list.png", "ffconcat version 1.0\nfile a.png\n");
    write("escape.png", "\x89PNG\r\n\x1a\n\0\0\0\1\x1b[7mcrc?"s);
    write("empty.png", "");
    ASSERT_EQ(mkfifo("pipe.png", 0600), 0);
    for (const auto& [name, reason] :
         {std::pair{"none.png", "No such file"},
          {"half.png", "ffmpeg"},
          {"list.png", "ffmpeg"},
          {"escape.png", "ffmpeg"},
          {"empty.png", "ffmpeg"},
          {"pipe.png", "it is not a regular file"},
          {"/dev/zero", "it is not a regular file"}}) {
        std::string error;
        EXPECT_FALSE(loadPicture(name, error)) << name;
        EXPECT_EQ(error.find("cannot read the picture "s + name + ": "), 0U) << error;
        EXPECT_NE(error.find(reason), error.npos) << error;
        EXPECT_EQ(error.find_first_of("\n\x1b"), error.npos) << error;
    }
    std::string error;
    EXPECT_FALSE(loadPicture("a.png", error, 127));
    EXPECT_TRUE(error.ends_with(": Picture size 16x8 exceeds specified max pixel count 127")) << error;
}
