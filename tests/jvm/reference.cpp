// Plays a scene to the host in C++ and keeps its pictures and its journal, for the host in Java to be held against.
#include <GLES2/gl2.h>

#include <cstdlib>
#include <fstream>
#include <functional>
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

int main(int, char** argv) {
    const std::string directory = std::string(argv[2]) + '/';
    std::ofstream journal(directory + "journal");
    LogRecorder log;
    std::string error;
    std::unique_ptr<HeadlessContext> context;
    std::map<std::string, Picture> pictures;
    LiveWater water(Look{}, 1);
    int width = 0, height = 0, drawn = 0, waited = 0;
    double now = 0.0;
    std::vector<std::string> words;
    std::vector<double> n;  // the words' values, from the first on

    const auto write = [&](const std::string& name, const std::vector<std::uint8_t>& rgba) {
        std::ofstream file(directory + name + ".rgba", std::ios::binary);
        file.write(reinterpret_cast<const char*>(rgba.data()), static_cast<std::streamsize>(rgba.size()));
    };
    const auto frame = [&](double rate) {
        const LiveWater::Frame result = water.frame(now += 1.0 / rate);
        drawn += result == LiveWater::Frame::drawn;
        waited += result == LiveWater::Frame::waiting;
        return result;
    };
    const auto whole = [&](std::size_t i) { return static_cast<int>(n[i]); };
    const auto touch = [&](TouchAction action, int x, int y, double pressure) {
        water.touch(action, x, y, static_cast<float>(pressure));
    };

    const std::map<std::string, std::function<void()>> commands = {
        {"picture", [&] { write(words[1], (pictures[words[1]] = smoothPicture(whole(2), whole(3), whole(4))).rgba); }},
        {"pictures",
         [&] {
             water.setPictures({pictures.at(words[1]), pictures.at(words[2]), pictures.at(words[3])});
         }},
        {"context",
         [&] {
             context.reset();
             context = HeadlessContext::create(160, 160, error);
             water.renewContext();
         }},
        {"resize", [&] { water.resize(width = whole(1), height = whole(2)); }},
        {"ink", [&] { water.setInk(words[1] == "on"); }},
        {"rain", [&] { water.setRain(words[1] == "on"); }},
        {"look",
         [&] {
             std::stringstream lines;
             for (std::size_t i = 1; i < words.size(); i += 2) lines << words[i] << " = " << words[i + 1] << '\n';
             water.setLook(parseLook(lines, "look", error).value());
         }},
        {"clear", [&] { water.clearInk(); }},
        {"redraw", [&] { water.redraw(); }},
        {"touch", [&] { touch(static_cast<TouchAction>(whole(1)), whole(2), whole(3), n[4]); }},
        {"stroke",
         [&] {
             touch(TouchAction::down, whole(1), whole(2), n[6]);
             for (int i = 1; i <= whole(5); ++i, frame(60)) {
                 touch(
                     TouchAction::move, whole(1) + (whole(3) - whole(1)) * i / whole(5),
                     whole(2) + (whole(4) - whole(2)) * i / whole(5), n[6]);
             }
         }},
        {"frames",
         [&] {
             for (int i = 0; i < whole(1); ++i) frame(n[2]);
         }},
        {"rest",
         [&] {
             while (frame(60) != LiveWater::Frame::resting && drawn < 2000) continue;
         }},
        {"wait", [&] { now += n[1]; }},
        {"keep",
         [&] {
             std::vector<std::uint8_t> pixels(4 * static_cast<std::size_t>(width * height));
             glReadPixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
             write(words[1], pixels);
         }},
    };

    std::ifstream scene(argv[1]);
    for (std::string line; std::getline(scene, line);) {
        if (line.empty() || line[0] == '#') continue;
        std::istringstream in(line);
        words.clear();
        n.clear();
        for (std::string word; in >> word;) {
            words.push_back(word);
            n.push_back(std::strtod(word.c_str(), nullptr));
        }
        drawn = waited = 0;
        commands.at(words[0])();
        journal << line << ": " << drawn << " drawn, " << waited << " waited\n";
        for (const std::string& said : log.take()) journal << said << '\n';
    }
}
