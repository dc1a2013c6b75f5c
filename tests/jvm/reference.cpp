// Plays a scene to the host in C++ and writes down each single call, what came of it and what the library logged, and
// beside that the pictures: for the host in Java to be held against.
#include <GLES2/gl2.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <map>
#include <memory>
#include <set>
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
    std::set<std::vector<std::uint8_t>> kept;
    LiveWater water(Look{}, 1);
    LiveWater::Frame shown{};
    int width = 0, height = 0, drawn = 0;
    double now = 0.0;
    std::vector<std::string> words;
    std::vector<double> n;  // the words' values, from the first on

    const auto write = [&](const std::vector<std::uint8_t>& rgba) {
        std::ofstream file(directory + words[1] + ".rgba", std::ios::binary);
        file.write(reinterpret_cast<const char*>(rgba.data()), static_cast<std::streamsize>(rgba.size()));
    };
    const auto whole = [&](std::size_t i) { return static_cast<int>(n[i]); };
    const auto real = [&](std::size_t i) { return static_cast<float>(n[i]); };
    const auto read = [&](const std::string& line) {
        std::istringstream in(line);
        words.clear();
        n.clear();
        for (std::string word; in >> word;) {
            words.push_back(word);
            n.push_back(std::strtod(word.c_str(), nullptr));
        }
    };

    const std::map<std::string, std::function<void()>> calls = {
        {"picture", [&] { write((pictures[words[1]] = smoothPicture(whole(2), whole(3), whole(4))).rgba); }},
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
             for (std::size_t i = 1; i < words.size(); ++i) lines << words[i] << '\n';
             water.setLook(parseLook(lines, "look", error).value());
         }},
        {"clear", [&] { water.clearInk(); }},
        {"redraw", [&] { water.redraw(); }},
        {"splash", [&] { water.splash(whole(1), whole(2), real(3)); }},
        {"touch", [&] { water.touch(static_cast<TouchAction>(whole(1)), whole(2), whole(3), real(4)); }},
        {"frame", [&] { drawn += (shown = water.frame(n[1])) == LiveWater::Frame::drawn; }},
        {"keep",
         [&] {
             std::vector<std::uint8_t> pixels(4 * static_cast<std::size_t>(width * height));
             glReadPixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
             write(pixels);
             if (!kept.insert(pixels).second) std::exit(1);  // shows nothing new
         }},
    };
    const auto call = [&](const std::string& line) {
        read(line);
        calls.at(words[0])();
        journal << line;
        if (words[0] == "frame") journal << ' ' << static_cast<int>(shown);
        journal << '\n';
        for (const std::string& said : log.take()) journal << said << '\n';
    };
    const auto frame = [&](double rate) {
        std::ostringstream line;
        line << "frame " << std::hexfloat << (now += 1.0 / rate);
        call(line.str());
        return shown;
    };
    const auto touch = [&](int action, double x, double y, double pressure) {
        std::ostringstream line;
        line << "touch " << action << ' ' << static_cast<int>(x) << ' ' << static_cast<int>(y) << ' ' << pressure;
        call(line.str());
    };

    std::ifstream scene(argv[1]);
    for (std::string line; std::getline(scene, line);) {
        if (line.empty() || line[0] == '#') continue;
        read(line);
        const std::vector<double> m = n;
        if (words[0] == "wait") {
            now += m[1];
        } else if (words[0] == "frames") {
            for (int i = 0; i < m[1]; ++i) frame(m[2]);
        } else if (words[0] == "rest") {
            while (frame(60.0) != LiveWater::Frame::resting && drawn < 3000) continue;
        } else if (words[0] == "stroke") {
            touch(0, m[1], m[2], m[6]);
            for (int i = 1; i <= m[5]; ++i, frame(60.0)) {
                touch(2, m[1] + (m[3] - m[1]) * i / m[5], m[2] + (m[4] - m[2]) * i / m[5], m[6]);
            }
        } else {
            call(line);
        }
    }
    return drawn >= 1000 ? 0 : 1;
}
