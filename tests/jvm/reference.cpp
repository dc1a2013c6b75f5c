// Plays a scene to the host in C++ and keeps its pictures and its journal, for the host in Java to be held against.
#include <GLES2/gl2.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "host/live_water.h"
#include "host/look_file.h"
#include "platform/headless_context.h"
#include "tests/support/log_recorder.h"
#include "tests/support/test_pictures.h"

namespace {

constexpr int kSide = 160;  // of framebuffer 0

[[noreturn]] void fail(const std::string& reason) {
    std::fprintf(stderr, "%s\n", reason.c_str());
    std::exit(1);
}

class Player {
public:
    explicit Player(std::string directory) : directory_(std::move(directory)), journal_(directory_ + "/journal") {}

    // Notes what became of the frames, and what the library said.
    void playLine(const std::string& line) {
        drawn_ = waited_ = 0;
        std::istringstream words(line);
        std::string command;
        words >> command;
        play(command, words);
        journal_ << line << ": " << drawn_ << " drawn, " << waited_ << " waited\n";
        for (const std::string& said : log_.take()) journal_ << said << '\n';
    }

private:
    void play(const std::string& command, std::istringstream& words) {
        std::string a, b, c;
        int x, y, endX, endY, count;
        float pressure;
        double number;
        if (command == "picture" && words >> a >> x >> y >> count) {
            pictures_[a] = smoothPicture(x, y, count);
            write(a, pictures_[a].rgba);
        } else if (command == "pictures" && words >> a >> b >> c) {
            water_.setPictures({pictures_.at(a), pictures_.at(b), pictures_.at(c)});
        } else if (command == "context") {
            std::string error;
            context_.reset();
            context_ = HeadlessContext::create(kSide, kSide, error);
            if (!context_) fail(error);
            water_.renewContext();
        } else if (command == "resize" && words >> width_ >> height_) {
            water_.resize(width_, height_);
        } else if (command == "ink" && words >> a) {
            water_.setInk(a == "on");
        } else if (command == "rain" && words >> a) {
            water_.setRain(a == "on");
        } else if (command == "look") {
            std::stringstream lines;
            while (words >> a >> b) lines << a << " = " << b << '\n';
            const std::optional<Look> look = parseLook(lines, command, a);
            if (!look) fail(a);
            water_.setLook(*look);
        } else if (command == "clear") {
            water_.clearInk();
        } else if (command == "redraw") {
            water_.redraw();
        } else if (command == "touch" && words >> count >> x >> y >> pressure) {
            water_.touch(static_cast<TouchAction>(count), x, y, pressure);
        } else if (command == "stroke" && words >> x >> y >> endX >> endY >> count >> pressure) {
            water_.touch(TouchAction::down, x, y, pressure);
            for (int i = 1; i <= count; ++i) {
                water_.touch(TouchAction::move, x + (endX - x) * i / count, y + (endY - y) * i / count, pressure);
                frame(60);
            }
        } else if (command == "frames" && words >> count >> number) {
            for (int i = 0; i < count; ++i) frame(number);
        } else if (command == "rest") {
            while (frame(60) != LiveWater::Frame::resting && drawn_ < 2000) continue;
        } else if (command == "wait" && words >> number) {
            now_ += number;
        } else if (command == "keep" && words >> a) {
            std::vector<std::uint8_t> pixels(4 * static_cast<std::size_t>(width_ * height_));
            glReadPixels(0, 0, width_, height_, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
            write(a, pixels);
        } else {
            fail("cannot play " + command);
        }
    }

    LiveWater::Frame frame(double rate) {
        const LiveWater::Frame frame = water_.frame(now_ += 1.0 / rate);
        drawn_ += frame == LiveWater::Frame::drawn;
        waited_ += frame == LiveWater::Frame::waiting;
        return frame;
    }

    void write(const std::string& name, const std::vector<std::uint8_t>& rgba) const {
        std::ofstream(directory_ + "/" + name + ".rgba", std::ios::binary)
            .write(reinterpret_cast<const char*>(rgba.data()), static_cast<std::streamsize>(rgba.size()));
    }

    LogRecorder log_;
    std::string directory_;
    std::ofstream journal_;
    std::map<std::string, Picture> pictures_;
    std::unique_ptr<HeadlessContext> context_;
    LiveWater water_{Look{}, 1};
    int width_ = 0;
    int height_ = 0;
    double now_ = 0.0;
    int drawn_ = 0;
    int waited_ = 0;
};

}  // namespace

int main(int, char** argv) {
    std::ifstream scene(argv[1]);
    if (!scene) fail("cannot read the scene");
    Player player(argv[2]);
    for (std::string line; std::getline(scene, line);) {
        if (!line.empty() && line[0] != '#') player.playLine(line);
    }
}
