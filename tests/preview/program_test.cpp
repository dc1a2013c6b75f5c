// The program as a user runs it: files in, files, messages and an exit code out.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <spawn.h>
#include <stb/stb_image_write.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <sstream>

#include "pictures/picture_file.h"

namespace fs = std::filesystem;

namespace {

std::string readFile(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

struct Outcome {
    int exitCode;
    std::string messages;  // what came on standard error
};

// Every test works in a directory of its own, which is the current one.
class PreviewProgram : public testing::Test {
protected:
    void SetUp() override {
        std::string name = (fs::path(testing::TempDir()) / "preview-XXXXXX").string();
        ASSERT_NE(mkdtemp(name.data()), nullptr);
        directory_ = name;
        fs::create_directory(directory_ / "work");
        fs::current_path(directory_ / "work");
    }
    void TearDown() override {
        fs::current_path(directory_.parent_path());
        fs::remove_all(directory_);
    }

    // Runs the program with a small, short scene before the arguments; later ones win where it matters.
    Outcome run(std::vector<std::string> arguments, const std::string& variable = "") const {
        const std::string log = (directory_ / "messages").string();
        arguments.insert(arguments.begin(), TIDEMARK_PREVIEW_PATH);
        std::vector<char*> argv;
        for (std::string& argument : arguments) argv.push_back(argument.data());
        argv.push_back(nullptr);
        std::vector<char*> environment;
        std::string setting = variable;
        const std::string name = variable.substr(0, variable.find('=') + 1);
        for (char** entry = environ; *entry; ++entry) {
            if (name.empty() || std::string(*entry).rfind(name, 0) != 0) environment.push_back(*entry);
        }
        if (!setting.empty()) environment.push_back(setting.data());
        environment.push_back(nullptr);

        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, log.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
        pid_t child = -1;
        const int problem = posix_spawn(&child, argv[0], &actions, nullptr, argv.data(), environment.data());
        posix_spawn_file_actions_destroy(&actions);
        if (problem != 0) return {-1, "cannot start " TIDEMARK_PREVIEW_PATH};
        int status = 0;
        waitpid(child, &status, 0);
        return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, readFile(log)};
    }

    static void expectSuccess(const Outcome& result) {
        EXPECT_EQ(result.exitCode, 0);
        EXPECT_EQ(result.messages, "");
    }

    void expectFailure(const Outcome& result, const std::string& reason) const {
        EXPECT_GT(result.exitCode, 0);
        EXPECT_NE(result.messages.find(reason), std::string::npos) << result.messages << " lacks " << reason;
        EXPECT_EQ(std::count(result.messages.begin(), result.messages.end(), '\n'), 1) << result.messages;
        EXPECT_TRUE(fs::is_empty(".")) << "left behind: " << fs::directory_iterator(".")->path() << " by " << reason;
    }

    // A file beside the working directory.
    std::string beside(const std::string& name, const std::string& text = "") const {
        const fs::path path = directory_ / name;
        if (!text.empty()) std::ofstream(path) << text;
        return path.string();
    }

private:
    fs::path directory_;
};

const std::vector<std::string> kSmall = {"--size", "48x80", "--seconds", "0.2"};

std::vector<std::string> small(std::vector<std::string> more) {
    more.insert(more.begin(), kSmall.begin(), kSmall.end());
    return more;
}

bool haveFfmpeg() {
    return std::system("ffmpeg -version >/dev/null 2>&1") == 0;
}

}  // namespace

TEST_F(PreviewProgram, StillWaterShowsThePictureOfItsOrientation) {
    for (const auto& [option, width, height] : {std::tuple{"--portrait", 60, 90}, std::tuple{"--landscape", 90, 60}}) {
        // Red grows to the right, green downwards.
        std::vector<std::uint8_t> pixels;
        for (int row = 0; row < height; ++row) {
            for (int column = 0; column < width; ++column) {
                pixels.push_back(static_cast<std::uint8_t>(255 * column / width));
                pixels.push_back(static_cast<std::uint8_t>(255 * row / height));
                pixels.push_back(40);
            }
        }
        const std::string photo = beside("photo.png");
        ASSERT_TRUE(stbi_write_png(photo.c_str(), width, height, 3, pixels.data(), 3 * width));
        const std::string size = std::to_string(width) + "x" + std::to_string(height);
        expectSuccess(run({"--size", size, "--seconds", "0.05", "--script", "/dev/null", option, photo, "--out", "o"}));
        std::string error;
        const std::optional<Picture> frame = loadPicture("o/frame-0002.png", error);
        ASSERT_TRUE(frame) << error;
        ASSERT_EQ(frame->width, width);
        ASSERT_EQ(frame->height, height);
        for (std::size_t i = 0; i < pixels.size() / 3; ++i) {
            ASSERT_NEAR(frame->rgba[4 * i], pixels[3 * i], 6) << option << " pixel " << i;
            ASSERT_NEAR(frame->rgba[4 * i + 1], pixels[3 * i + 1], 6) << option << " pixel " << i;
            ASSERT_NEAR(frame->rgba[4 * i + 2], 40, 2) << option << " pixel " << i;
        }
        EXPECT_FALSE(fs::exists("o/frame-0003.png"));
    }
}

TEST_F(PreviewProgram, TouchesMoveTheWaterInTheFrameThatTheyFallInto) {
    const std::string script = beside("a.touch", "100 down 50% 50% 1\n110 up 50% 50% 1\n");
    expectSuccess(run({"--size", "48x80", "--fps", "20", "--seconds", "0.25", "--script", script, "--out", "o"}));
    EXPECT_EQ(readFile("o/frame-0000.png"), readFile("o/frame-0001.png"));
    EXPECT_NE(readFile("o/frame-0001.png"), readFile("o/frame-0002.png"));
    EXPECT_NE(readFile("o/frame-0002.png"), readFile("o/frame-0003.png"));
    const std::string numb = beside("numb.look", "touchAmplitude = 0\n");
    expectSuccess(run(
        {"--size", "48x80", "--fps", "20", "--seconds", "0.25", "--script", script, "--no-ink", "--look", numb, "--out",
         "numb"}));
    EXPECT_EQ(readFile("numb/frame-0001.png"), readFile("numb/frame-0003.png"));
    // Left to itself a scene outlasts its script.
    expectSuccess(run({"--size", "48x80", "--fps", "10", "--script", script, "--out", "whole"}));
    EXPECT_TRUE(fs::exists("whole/frame-0015.png"));
}

TEST_F(PreviewProgram, SameInputsGiveTheSameBytes) {
    const std::string script = beside("tap.touch", "100 down 50% 50% 1\n110 up 50% 50% 1\n");
    const std::vector<std::string> scene = {"--size", "200x300",  "--fps", "30",      "--seconds", "1",
                                            "--rain", "--script", script,  "--every", "2"};
    const auto render = [&](const std::string& seed, const std::string& out) {
        std::vector<std::string> arguments = scene;
        arguments.insert(arguments.end(), {"--seed", seed, "--out", out});
        if (haveFfmpeg()) arguments.insert(arguments.end(), {"--video", out + "/rain.mp4"});
        expectSuccess(run(arguments));
    };
    render("5", "a");
    render("5", "b");
    render("6", "c");
    int files = 0;
    bool seedMatters = false;
    for (const auto& entry : fs::directory_iterator("a")) {
        EXPECT_EQ(readFile(entry.path()), readFile("b" / entry.path().filename())) << entry.path();
        seedMatters |= readFile(entry.path()) != readFile("c" / entry.path().filename());
        ++files;
    }
    EXPECT_EQ(files, haveFfmpeg() ? 16 : 15);
    EXPECT_TRUE(seedMatters);
}

TEST_F(PreviewProgram, MakesVideosOfEachKind) {
    if (!haveFfmpeg()) GTEST_SKIP() << "ffmpeg is not installed";
    for (const auto& [file, starts, at] :
         {std::tuple{"new/water.mp4", "ftyp", 4}, std::tuple{"water.webp", "WEBP", 8},
          std::tuple{"water.gif", "GIF89a", 0}}) {
        expectSuccess(run({"--size", "49x81", "--fps", "30", "--seconds", "0.5", "--rain", "--video", file}));
        EXPECT_EQ(readFile(file).compare(static_cast<std::size_t>(at), std::strlen(starts), starts), 0) << file;
        EXPECT_FALSE(fs::exists("out"));
        EXPECT_FALSE(fs::exists(std::string(file) + ".part"));
    }
    ASSERT_EQ(
        std::system("ffprobe -v error -count_frames -show_entries stream=width,height,nb_read_frames "
                    "-of csv=p=0 new/water.mp4 > probe"),
        0);
    EXPECT_EQ(readFile("probe"), "50,82,15\n");
}

TEST_F(PreviewProgram, ShowsTheInsideOfAStroke) {
    const std::string scene = TIDEMARK_SCENES_PATH "/curl.touch";
    expectSuccess(run({"--size", "300x290", "--seconds", "0.5", "--script", scene, "--inside", "i"}));
    for (const std::string name : {"height", "velocity", "density", "result"}) {
        std::string error;
        const std::optional<Picture> picture = loadPicture("i/" + name + ".png", error);
        ASSERT_TRUE(picture) << error;
        EXPECT_EQ(std::pair(picture->width, picture->height), std::pair(300, 290));
        std::uint8_t darkest = 255, brightest = 0;
        for (std::size_t i = 1; i < picture->rgba.size(); i += 4) {
            darkest = std::min(darkest, picture->rgba[i]);
            brightest = std::max(brightest, picture->rgba[i]);
        }
        EXPECT_GT(brightest - darkest, 100) << name;  // the dimmed frame below the arrows has less
    }
}

TEST_F(PreviewProgram, RefusesBadInputInOneLineAndLeavesNothing) {
    const std::string junk = beside("junk.png", "not a picture");
    const std::string badLine = beside("bad.touch", "0 down 1 1 1\n\n5 tap 1 1 1\n");
    const std::string badLook = beside("bad.look", "damping = 0.9\ndamping = 2\n");
    const struct {
        std::vector<std::string> arguments;
        std::string reason;
    } cases[] = {
        {{"--portrait", "none.png"}, "none.png: No such file"},
        {{"--landscape", junk}, "junk.png is not a PNG or JPEG"},
        {{"--water", "/"}, "/ is not a PNG or JPEG"},
        {{"--script", badLine}, "bad.touch:3: "},
        {{"--look", badLook}, "bad.look:2: "},
        {{"--script", "none.touch"}, "none.touch: No such file"},
        {{"--script", "/"}, "cannot read the touch script /"},
        {{"--out", junk}, "junk.png"},
        {{"--out", "/proc/frames"}, "/proc/frames"},
        {{"--out", "made/for/it", "--video", "water.avi"}, "does not end in .mp4, .webp or .gif"},
        {{"--out", "made", "--video", "/proc/water.mp4"}, "/proc/water.mp4"},
        {{"--ink", "blue"}, "--ink blue is not #rrggbb"},
        {{"--ink", "#112233", "--no-ink"}, "--no-ink"},
        {{"--fps", "0"}, "--fps"},
        {{"--seed", "-1"}, "--seed"},
        {{"--colour"}, "--colour"},
    };
    for (const auto& bad : cases) expectFailure(run(small(bad.arguments)), bad.reason);
    expectFailure(run({"--window", "--video", "water.mp4"}), "excludes --window");
    expectFailure(run({"--window"}, "DISPLAY="), "no screen for a window");
    for (const char* size : {"0x0", "10", "10x-1", "100000x100000"}) expectFailure(run({"--size", size}), size);
    for (const char* seconds : {"0", "-1", "nan", "inf", "1e9", "x"}) {
        expectFailure(run({"--size", "48x80", "--seconds", seconds}), "--seconds");
    }
}

TEST_F(PreviewProgram, NamesTheMissingPackage) {
    expectFailure(run(small({"--out", "made", "--video", "also/water.mp4"}), "PATH=/nowhere"), "package ffmpeg");
    expectFailure(run(small({}), "__EGL_VENDOR_LIBRARY_DIRS=/nowhere"), "libegl-mesa0");
}

TEST_F(PreviewProgram, TakesBackAVideoThatFailsHalfWay) {
    fs::create_directory("../bin");
    const std::string ffmpeg = beside("bin/ffmpeg", "#!/bin/sh\necho out of luck >&2\nexit 3\n");
    fs::permissions(ffmpeg, fs::perms::owner_all);
    expectFailure(run(small({"--out", "made", "--video", "water.gif"}), "PATH=" + beside("bin")), "out of luck");
}

TEST_F(PreviewProgram, ScalesPicturesThatTheDriverCannotTake) {
    const std::vector<std::uint8_t> strip(40000 * 3, 90);
    const std::string photo = beside("strip.png");
    ASSERT_TRUE(stbi_write_png(photo.c_str(), 40000, 1, 3, strip.data(), 40000 * 3));
    const Outcome result = run(small({"--water", photo, "--out", "o"}));
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_NE(result.messages.find("scaled from 40000x1 to "), std::string::npos) << result.messages;
}

TEST_F(PreviewProgram, ShowsTheLogOnlyWhenAsked) {
    const Outcome result = run(small({"--out", "o", "--verbose"}));
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_NE(result.messages.find("I/Tidemark_Native: onInitSetting"), std::string::npos) << result.messages;
}
