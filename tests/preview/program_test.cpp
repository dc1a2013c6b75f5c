// The program as a process: its files, messages and exit code.
#include "tests/preview/program.h"

#include <sys/stat.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <fstream>

#include "preview/picture_file.h"

using namespace tidemark;

namespace fs = std::filesystem;

static Picture load(const std::string& path) {
    std::string error;
    return loadPicture(path, error).value_or(Picture{});
}

static void save(const Picture& picture, const std::string& path) {
    std::string error;
    ASSERT_TRUE(savePicture(picture, path, error)) << error;
}

// Returns the mean difference of two pictures' channels.
static double difference(const Picture& a, const Picture& b) {
    double sum = 0;
    for (std::size_t i = 0; i < a.rgba.size(); ++i) sum += std::abs(a.rgba[i] - b.rgba.at(i));
    return sum / static_cast<double>(a.rgba.size());
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
        save(photo, "../photo.png");
        EXPECT_TRUE(
            draws(option + std::string(" ../photo.png --script ../still.touch --seconds 0.05 --out o --force")));
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
    EXPECT_TRUE(draws(scene + "--look ../still.look --out o"));
    EXPECT_EQ(load("o/frame-0000.png").rgba, load("o/frame-0001.png").rgba);
    const std::vector<std::uint8_t> before = load("o/frame-0001.png").rgba, after = load("o/frame-0002.png").rgba;
    const auto half = static_cast<std::ptrdiff_t>(before.size() / 2);
    EXPECT_NE(before, after);
    EXPECT_TRUE(std::equal(before.begin(), before.begin() + half, after.begin())) << "far from the finger";
    EXPECT_NE(load("o/frame-0002.png").rgba, load("o/frame-0003.png").rgba);
    EXPECT_EQ(run("ls o | wc -l"), "32\n0\n") << "left to itself a scene outlasts its script";
    EXPECT_TRUE(draws(scene + "--seconds 0.3 --no-ink --look ../numb.look --out numb"));
    EXPECT_EQ(load("numb/frame-0001.png").rgba, load("numb/frame-0005.png").rgba);
}

TEST_F(Program, SameInputsGiveTheSameBytesInVideosOfEachKind) {
    const std::string scene = "--size 49x81 --fps 10 --seconds 1 --rain 0.4 --every 2 ";
    EXPECT_TRUE(draws(scene + "--seed 5 --out a --video a/rain.mp4"));
    EXPECT_TRUE(draws(scene + "--seed 5 --out b --video b/rain.mp4"));
    EXPECT_TRUE(draws(scene + "--seed 6 --out c --video c/rain.gif"));
    EXPECT_TRUE(draws("--size 49x81 --fps 10 --seconds 1 --video new/rain.webp"));
    EXPECT_EQ(
        run("ls . a new | tr '\\n' ' '"),
        ".: a b c new  a: frame-0000.png frame-0001.png frame-0002.png frame-0003.png frame-0004.png rain.mp4  "
        "new: rain.webp 0\n");
    EXPECT_EQ(run("diff -r a b"), "0\n");
    EXPECT_EQ(load("a/frame-0001.png").rgba, load("c/frame-0001.png").rgba) << "it rains too early";
    EXPECT_NE(load("a/frame-0004.png").rgba, load("c/frame-0004.png").rgba) << "the rain has no seed";
    const std::string probe =
        "ffprobe -v error -count_frames -show_entries stream=width,height,nb_read_frames -of csv=p=0 ";
    EXPECT_EQ(run(probe + "a/rain.mp4"), "50,82,10\n0\n");
    EXPECT_EQ(run(probe + "c/rain.gif"), "49,81,10\n0\n");
    EXPECT_EQ(run("head -c 12 new/rain.webp | tail -c 4"), "WEBP0\n");
}

TEST_F(Program, DrawsTheFieldsOfAStroke) {
    const std::string scene = "--picture shore --size 100x96 --fps 60 --seconds 0.5 --script curl ";
    EXPECT_TRUE(draws(scene + "--fields i"));
    for (const std::string name : {"height", "velocity", "density", "result"}) {
        const Picture picture = load("i/" + name + ".png");
        ASSERT_EQ(std::pair(picture.width, picture.height), std::pair(100, 96)) << name;
        int darkest = 255, brightest = 0;
        for (std::size_t i = 1; i < picture.rgba.size(); i += 4) {
            darkest = std::min<int>(darkest, picture.rgba[i]);
            brightest = std::max<int>(brightest, picture.rgba[i]);
        }
        EXPECT_GT(brightest - darkest, 100) << name;  // the dimmed background of the arrows has a smaller range
    }
    EXPECT_TRUE(draws(scene + "--fields other --seed 2"));
    EXPECT_NE(load("i/density.png").rgba, load("other/density.png").rgba) << "the ink has no seed";
}

TEST_F(Program, SaysWhatItChangesAndTheLogWhenAsked) {
    save({40000, 1, std::vector<std::uint8_t>(4 * 40000, 90)}, "../strip.png");
    const std::string output = preview(
        "--size 48x80 --seconds 0.1 --light ../strip.png --script curl --ink '#80ff20' --still a.png --verbose");
    EXPECT_NE(output.find("scaled from 40000x1 to "), std::string::npos) << output;
    EXPECT_NE(output.find("#80ff20 is too bright to darken the picture; #80bf20 is drawn"), output.npos) << output;
    EXPECT_NE(output.find("I/Tidemark_Native: onInitSetting"), std::string::npos) << output;
    EXPECT_TRUE(fs::exists("a.png"));
}

TEST_F(Program, OneFrameIsThatOfItsTime) {
    EXPECT_TRUE(draws("--size 48x80 --script curl --fps 20 --seconds 1 --out o --still all.png --at 0.4"));
    EXPECT_TRUE(draws("--size 48x80 --script curl --fps 20 --still only.png --at 0.4"));
    EXPECT_EQ(load("all.png").rgba, load("o/frame-0007.png").rgba);
    EXPECT_EQ(load("only.png").rgba, load("o/frame-0007.png").rgba);
}

TEST_F(Program, ALoopGoesOnWhereItEnds) {
    // The rain differs from round to round, and the water does not calm down within one.
    EXPECT_TRUE(draws("--size 48x80 --fps 20 --seconds 2 --rain --no-ink --loop --out o"));
    EXPECT_EQ(run("ls o | wc -l"), "40\n0\n");
    double most = 0;
    for (int i = 1; i < 40; ++i) {
        const auto frame = [](int number) {
            return load("o/frame-00" + std::to_string(100 + number).substr(1) + ".png");
        };
        most = std::max(most, difference(frame(i - 1), frame(i)));
    }
    EXPECT_LT(difference(load("o/frame-0039.png"), load("o/frame-0000.png")), most);
}

TEST_F(Program, KeepsWhatWasThereUnlessToldOtherwise) {
    const std::string scene = "--size 48x80 --fps 20 --script curl ";
    EXPECT_TRUE(draws(scene + "--seconds 1 --out o --video v.mp4"));
    const std::string before = run("cat o/* v.mp4 | md5sum");
    fs::create_directory("../bin");
    std::ofstream("../bin/ffmpeg") << "#!/bin/sh\n/bin/cat >/dev/null; echo other >late.mp4\n";
    fs::permissions("../bin/ffmpeg", fs::perms::owner_all);
    for (const auto& [arguments, environment, reason] :
         {std::tuple{"--out o", "", "o/frame-0000.png exists already"},
          {"--video v.mp4", "", "v.mp4 exists already"},
          {"--out o --video v.mp4 --force", "sh -c 'ulimit -f 8; exec \"$@\"' sh", "cannot write"},
          {"--video late.mp4", "PATH=../bin", "late.mp4 exists already"}}) {
        const std::string output = preview(scene + "--seconds 0.5 " + arguments, environment);
        EXPECT_NE(output.find(reason), output.npos) << output;
        EXPECT_TRUE(output.ends_with("\n1\n")) << output;
    }
    EXPECT_EQ(run("cat o/* v.mp4 | md5sum"), before);
    EXPECT_EQ(run("ls; cat late.mp4"), "late.mp4\no\nv.mp4\nother\n0\n");
    EXPECT_TRUE(draws(scene + "--seconds 0.5 --out o --video v.mp4 --force"));
    EXPECT_EQ(run("ls o | wc -l"), "10\n0\n") << "frames of the longer run";
}

TEST_F(Program, FinishesAClipThatIsInterrupted) {
    const std::string output =
        run("sh -c '\"" TIDEMARK_PREVIEW_PATH
            "\" --size 48x80 --seconds 3600 --out o --video v.mp4 & "
            "until [ -s o/frames.part-$!/frame-0005.png ]; do sleep 0.05; done; kill -INT $!; wait $!'");
    EXPECT_TRUE(output.starts_with("Interrupted: drew ")) << output;
    EXPECT_NE(output.find(" of 216000 frames, "), output.npos) << output;
    EXPECT_TRUE(output.ends_with("\n130\n")) << output;
    const int frames = std::atoi(output.c_str() + 18);
    EXPECT_EQ(run("ls o | wc -l"), std::to_string(frames) + "\n0\n");
    EXPECT_EQ(
        run("ffprobe -v error -count_frames -show_entries stream=nb_read_frames -of csv=p=0 v.mp4"),
        std::to_string(frames) + "\n0\n");
}

TEST_F(Program, RefusesBadInputInOneLine) {
    std::ofstream("../junk.png") << "not a picture";
    std::ofstream("../bad.touch") << "0 down 1 1 1\n\n5 tap 1 1 1\n";
    std::ofstream("../bad.look") << "damping = 0.9\ndamping = 2\n";
    std::ofstream("../large");
    fs::resize_file("../large", (16 << 20) + 1);
    ASSERT_EQ(mkfifo("../pipe", 0600), 0);
    fs::create_directory("../bin");
    std::ofstream("../bin/ffmpeg") << "#!/bin/sh\necho out of luck >&2\nexit 3\n";
    fs::permissions("../bin/ffmpeg", fs::perms::owner_all);
    const struct {
        int code;
        const char *arguments, *reason, *environment = "";
    } cases[] = {
        {1, "--still a.png --portrait none.png", "none.png: No such file"},
        {1, "--still a.png --picture ../junk.png", "the picture ../junk.png: ffmpeg failed: "},
        {1, "--still a.png --script ../bad.touch", "bad.touch:3: "},
        {1, "--still a.png --script none.touch", "none.touch: No such file"},
        {1, "--still a.png --script /", "the touch script /: it is not a regular file"},
        {1, "--still a.png --look /dev/zero", "the look /dev/zero: it is not a regular file"},
        {1, "--still a.png --light ../pipe", "the picture ../pipe: it is not a regular file"},
        {1, "--still a.png --script ../large", "the touch script ../large: it has more than 16777216 bytes"},
        {1, "--still a.png --look ../bad.look", "bad.look:2: "},
        {1, "--out o --loop --script demo --seconds 1", "the script is longer than --seconds"},
        {1, "--out /proc/frames", "/proc/frames"},
        {1, "--video /proc/water.mp4", "/proc/water.mp4"},
        {1, "--video water.mp4", "package ffmpeg", "PATH=/nowhere"},
        {1, "--video water.gif", "ffmpeg failed: out of luck", "PATH=../bin"},
        {1, "--out o", "libegl-mesa0", "__EGL_VENDOR_LIBRARY_DIRS=/nowhere"},
        {1, "--window", "no screen for a window", "DISPLAY="},
        {2, "", "nothing to do"},
        {2, "--video water.avi", "does not end in .gif or .mp4 or .webp"},
        {2, "--video a.gif --fps 60", "50"},
        {2, "--video a.gif --crf 20", "--crf"},
        {2, "--window --video water.mp4", "--video is not for a window"},
        {2, "--window --rain 2", "--rain N is not for a window"},
        {2, "--still a.png --record a.touch", "--record"},
        {2, "--still a.png --landscape a.jpg", "--landscape"},
        {2, "--still a.png --every 2", "--out"},
        {2, "--still a.png --seconds 1 --at 2", "--at"},
        {2, "--preset quicksilver --fields i", "ink"},
        {2, "--ink blue", "blue is not #rrggbb"},
        {2, "--ink '#112233' --no-ink", "--no-ink"},
        {2, "--out o --every 0", "not in range 1 to"},
        {2, "--fps 0", "--fps"},
        {2, "--seconds nan", "--seconds"},
        {2, "--rain nan --seconds 1", "--rain"},
        {2, "--seconds 3601", "--seconds"},
        {2, "--size 10x-1", "-1"},
        {2, "--size 10", "--size"},
        {2, "--size 10x8193", "8193"},
        {2, "--size 10x10x10", "--size"},
    };
    for (const auto& [code, arguments, reason, environment] : cases) {
        const std::string small = std::string(arguments).find("--size") == 0 ? "" : "--size 48x80 --seconds 0.1 ";
        const bool takesSeconds = std::string(arguments).find("--seconds") == std::string::npos &&
                                  std::string(arguments).find("--window") == std::string::npos;
        const std::string output = preview((takesSeconds ? small : "") + arguments, environment);
        EXPECT_NE(output.find(reason), std::string::npos) << output << " lacks " << reason;
        EXPECT_EQ(std::count(output.begin(), output.end(), '\n'), 2) << output;
        EXPECT_TRUE(output.ends_with("\n" + std::to_string(code) + "\n")) << arguments << ": " << output;
        EXPECT_EQ(run("find -type f"), "0\n") << "left behind by " << arguments;
    }
}
