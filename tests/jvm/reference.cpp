// Plays a scene to the host in C++ and keeps the pictures for the host in Java to be held against.
#include <GLES2/gl2.h>
#include <stb/stb_image_write.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include "host/water_host.h"
#include "pictures/procedural_pictures.h"
#include "platform/headless_context.h"

namespace {

// Of other proportions than the views, so that a wrong crop shows.
const Picture kPortrait = riverBed(150, 200);
const Picture kLandscape = riverBed(260, 120);
const Picture kWater = waterLight(64);

[[noreturn]] void fail(const std::string& reason) {
    std::fprintf(stderr, "%s\n", reason.c_str());
    std::exit(1);
}

class Player {
public:
    explicit Player(std::string directory) : directory_(std::move(directory)) {}

    void play(const std::string& command, std::istringstream& words) {
        std::string word;
        int x, y, endX, endY, count;
        float pressure;
        if (command == "view" && words >> width_ >> height_) {
            renewContext();
            if (!host_) host_.emplace(Look{}, width_, height_, 1);
            host_->resize(width_, height_);
            host_->handOver(kPortrait, kLandscape, kWater);
            host_->setUp(withInk_);
        } else if (command == "lose") {
            renewContext();
            host_->setUp(withInk_);
        } else if (command == "ink" && words >> word) {
            withInk_ = word == "on";
            host_->setUp(withInk_);
        } else if (command == "rain" && words >> word) {
            host_->rain(word == "on");
        } else if (command == "touch" && words >> count >> x >> y >> pressure) {
            host_->touch(static_cast<TouchAction>(count), x, y, pressure);
        } else if (command == "stroke" && words >> x >> y >> endX >> endY >> count >> pressure) {
            host_->touch(TouchAction::down, x, y, pressure);
            for (int i = 1; i <= count; ++i) {
                host_->touch(TouchAction::move, x + (endX - x) * i / count, y + (endY - y) * i / count, pressure);
                drawFrames(1);
            }
            host_->touch(TouchAction::up, endX, endY, pressure);
        } else if (command == "clear") {
            host_->clearInk();
        } else if (command == "frames" && words >> count) {
            drawFrames(count);
        } else if (command == "picture" && words >> word) {
            keepPicture(word);
        } else {
            fail("cannot play " + command);
        }
    }

    int drawn() const { return drawn_; }

private:
    void renewContext() {
        std::string error;
        context_.reset();
        context_ = HeadlessContext::create(width_, height_, error);
        if (!context_) fail(error);
    }

    void drawFrames(int count) {
        for (int i = 0; i < count; ++i) {
            if (!host_->advance(1.0 / 60)) continue;
            host_->draw();
            ++drawn_;
        }
    }

    void keepPicture(const std::string& name) const {
        std::vector<char> pixels(4 * static_cast<std::size_t>(width_ * height_));
        glReadPixels(0, 0, width_, height_, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
        std::ofstream(directory_ + "/" + name + ".rgba", std::ios::binary)
            .write(pixels.data(), static_cast<std::streamsize>(pixels.size()));
    }

    std::string directory_;
    std::unique_ptr<HeadlessContext> context_;
    std::optional<WaterHost> host_;
    int width_ = 0;
    int height_ = 0;
    bool withInk_ = false;
    int drawn_ = 0;
};

void writePng(const std::string& path, const Picture& picture) {
    if (!stbi_write_png(path.c_str(), picture.width, picture.height, 4, picture.rgba.data(), picture.width * 4)) {
        fail("cannot write " + path);
    }
}

}  // namespace

int main(int, char** argv) {
    const std::string directory = argv[2];
    writePng(directory + "/portrait.png", kPortrait);
    writePng(directory + "/landscape.png", kLandscape);
    writePng(directory + "/water.png", kWater);

    std::ifstream scene(argv[1]);
    if (!scene) fail("cannot read the scene");
    Player player(directory);
    for (std::string line; std::getline(scene, line);) {
        std::istringstream words(line);
        std::string command;
        if (words >> command && command[0] != '#') player.play(command, words);
    }
    std::ofstream(directory + "/drawn") << player.drawn() << "\n";
}
