// The program as a user runs it: files in, files, messages and an exit code out.
#include "tests/preview/program.h"

#include <stb/stb_image_write.h>
#include <sys/stat.h>

#include <algorithm>
#include <fstream>

#include "pictures/picture_file.h"

namespace fs = std::filesystem;

static Picture load(const std::string& path) {
    std::string error;
    return loadPicture(path, error).value_or(Picture{});
}

TEST_F(Program, StillWaterShowsThePictureOfItsOrientation) {
    std::ofstream("../still.touch");
    for (const auto& [option, width, height] :
         {std::tuple{"--size 40x60 --portrait", 40, 60}, {"--size 60x40 --landscape", 60, 40}}) {
        Picture photo{width, height, {}};
        for (int i = 0; i < width * height; ++i) {
            photo.rgba.insert(
                photo.rgba.end(), {std::uint8_t(4 * (i % width)), std::uint8_t(4 * (i / width)), 40, 255});
        }
        ASSERT_TRUE(stbi_write_png("../photo.png", width, height, 4, photo.rgba.data(), 0));
        EXPECT_EQ(preview(option + std::string(" ../photo.png --script ../still.touch --seconds 0.05 --out o")), "0\n");
        const Picture frame = load("o/frame-0002.png");
        ASSERT_EQ(std::pair(frame.width, frame.height), std::pair(width, height));
        for (std::size_t i = 0; i < frame.rgba.size(); ++i) ASSERT_NEAR(frame.rgba[i], photo.rgba[i], 6) << i;
    }
}

TEST_F(Program, TouchesMoveTheWaterInTheFrameThatTheyFallInto) {
    std::ofstream("../tap.touch") << "100 down 50% 90% 1\n110 up 50% 90% 1\n";
    std::ofstream("../numb.look") << "touchAmplitude = 0\nbreeze = 0\n";
    std::ofstream("../still.look") << "breeze = 0\n";
    const std::string scene = "--size 48x80 --fps 20 --script ../tap.touch ";
    EXPECT_EQ(preview(scene + "--look ../still.look --out o"), "0\n");
    EXPECT_EQ(load("o/frame-0000.png").rgba, load("o/frame-0001.png").rgba);
    const std::vector<std::uint8_t> before = load("o/frame-0001.png").rgba, after = load("o/frame-0002.png").rgba;
    const auto half = static_cast<std::ptrdiff_t>(before.size() / 2);
    EXPECT_NE(before, after);
    EXPECT_TRUE(std::equal(before.begin(), before.begin() + half, after.begin())) << "far from the finger";
    EXPECT_NE(load("o/frame-0002.png").rgba, load("o/frame-0003.png").rgba);
    EXPECT_EQ(run("ls o | wc -l"), "32\n0\n") << "left to itself a scene outlasts its script";
    EXPECT_EQ(preview(scene + "--seconds 0.3 --no-ink --look ../numb.look --out numb"), "0\n");
    EXPECT_EQ(load("numb/frame-0001.png").rgba, load("numb/frame-0005.png").rgba);
}

TEST_F(Program, SameInputsGiveTheSameBytesInVideosOfEachKind) {
    const std::string scene = "--size 49x81 --fps 10 --seconds 1 --rain --every 2 ";
    EXPECT_EQ(preview(scene + "--seed 5 --out a --video a/rain.mp4"), "0\n");
    EXPECT_EQ(preview(scene + "--seed 5 --out b --video b/rain.mp4"), "0\n");
    EXPECT_EQ(preview(scene + "--seed 6 --out c --video c/rain.gif"), "0\n");
    EXPECT_EQ(preview(scene + "--video new/rain.webp"), "0\n");
    EXPECT_EQ(
        run("ls . a new | tr '\\n' ' '"),
        ".: a b c new  a: frame-0000.png frame-0001.png frame-0002.png frame-0003.png frame-0004.png rain.mp4  "
        "new: rain.webp 0\n");
    EXPECT_EQ(run("diff -r a b"), "0\n");
    EXPECT_NE(load("a/frame-0004.png").rgba, load("c/frame-0004.png").rgba) << "the rain has no seed";
    const std::string probe =
        "ffprobe -v error -count_frames -show_entries stream=width,height,nb_read_frames -of csv=p=0 ";
    EXPECT_EQ(run(probe + "a/rain.mp4"), "50,82,10\n0\n");
    EXPECT_EQ(run(probe + "c/rain.gif"), "49,81,10\n0\n");
    EXPECT_EQ(run("head -c 12 new/rain.webp | tail -c 4"), "WEBP0\n");
}

TEST_F(Program, ShowsTheInsideOfAStroke) {
    const std::string scene =
        "--ground shore --size 100x96 --fps 60 --seconds 0.5 --script '" TIDEMARK_SCENES_PATH "/curl.touch' ";
    EXPECT_EQ(preview(scene + "--inside i"), "0\n");
    for (const std::string name : {"height", "velocity", "density", "result"}) {
        const Picture picture = load("i/" + name + ".png");
        ASSERT_EQ(std::pair(picture.width, picture.height), std::pair(100, 96)) << name;
        int darkest = 255, brightest = 0;
        for (std::size_t i = 1; i < picture.rgba.size(); i += 4) {
            darkest = std::min<int>(darkest, picture.rgba[i]);
            brightest = std::max<int>(brightest, picture.rgba[i]);
        }
        EXPECT_GT(brightest - darkest, 100) << name;  // the dimmed frame below the arrows has less
    }
    EXPECT_EQ(preview(scene + "--inside other --seed 2"), "0\n");
    EXPECT_NE(load("i/density.png").rgba, load("other/density.png").rgba) << "the ink has no seed";
}

TEST_F(Program, SaysWhatItScalesAndTheLogWhenAsked) {
    const std::vector<std::uint8_t> strip(40000 * 3, 90);
    ASSERT_TRUE(stbi_write_png("../strip.png", 40000, 1, 3, strip.data(), 0));
    const std::string output = preview("--size 48x80 --seconds 0.1 --light ../strip.png --verbose");
    EXPECT_NE(output.find("scaled from 40000x1 to "), std::string::npos) << output;
    EXPECT_NE(output.find("I/Tidemark_Native: onInitSetting"), std::string::npos) << output;
    EXPECT_TRUE(fs::exists("out/frame-0005.png"));
}

TEST_F(Program, RefusesBadInputInOneLineAndLeavesNothing) {
    std::ofstream("../junk.png") << "not a picture";
    std::ofstream("../bad.touch") << "0 down 1 1 1\n\n5 tap 1 1 1\n";
    std::ofstream("../bad.look") << "damping = 0.9\ndamping = 2\n";
    std::ofstream("../large");
    fs::resize_file("../large", (16 << 20) + 1);
    ASSERT_EQ(mkfifo("../pipe", 0600), 0);
    fs::create_directory("../bin");
    std::ofstream("../bin/ffmpeg")
        << "#!/bin/sh\ncase $* in *late*) /bin/cat >/dev/null; esac\necho out of luck >&2\nexit 3\n";
    fs::permissions("../bin/ffmpeg", fs::perms::owner_all);
    const struct {
        const char *arguments, *reason, *environment = "";
    } cases[] = {
        {"--portrait none.png", "none.png: No such file"},
        {"--landscape ../junk.png", "junk.png is not a PNG or JPEG"},
        {"--script ../bad.touch", "bad.touch:3: "},
        {"--script none.touch", "none.touch: No such file"},
        {"--script /", "the touch script /: it is not a regular file"},
        {"--look /dev/zero", "the look /dev/zero: it is not a regular file"},
        {"--light ../pipe", "the picture ../pipe: it is not a regular file"},
        {"--script ../large", "the touch script ../large: it has more than 16777216 bytes"},
        {"--look ../bad.look", "bad.look:2: "},
        {"--look no.look", "no.look: No such file"},
        {"--out /proc/frames", "/proc/frames"},
        {"--out made/for/it --video water.avi", "does not end in .mp4, .webp or .gif"},
        {"--out made --video /proc/water.mp4", "/proc/water.mp4"},
        {"--out made --video also/water.mp4", "package ffmpeg", "PATH=/nowhere"},
        {"--out made --video water.gif", "ended early: out of luck", "PATH=../bin"},
        {"--out made --video late.gif --seconds 0.1", "failed: out of luck", "PATH=../bin"},
        {"--out made", "libegl-mesa0", "__EGL_VENDOR_LIBRARY_DIRS=/nowhere"},
        {"--window", "no screen for a window", "DISPLAY="},
        {"--window --video water.mp4", "excludes --window"},
        {"--ink blue", "--ink blue is not #rrggbb"},
        {"--ink '#112233' --no-ink", "--no-ink"},
        {"--fps 0", "--fps"},
        {"--seconds nan", "--seconds"},
        {"--seconds 0", "--seconds"},
        {"--seconds 3601", "--seconds"},
        {"--size 10x-1", "10x-1"},
    };
    for (const auto& [arguments, reason, environment] : cases) {
        const std::string small = std::string(arguments).find("--size") == 0 ? "" : "--size 48x80 ";
        const std::string output = preview(small + arguments, environment);
        EXPECT_NE(output.find(reason), std::string::npos) << output << " lacks " << reason;
        EXPECT_EQ(std::count(output.begin(), output.end(), '\n'), 2) << output;
        EXPECT_TRUE(output.ends_with("\n1\n") || output.ends_with("\n2\n")) << output;
        EXPECT_EQ(run("ls"), "0\n") << "left behind by " << arguments;
    }
}
