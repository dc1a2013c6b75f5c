// What long sessions are made of.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <set>
#include <string_view>

#include "preview/touch_script.h"
#include "probes/smooth_picture.h"

// A taste in every run of the tests, all of it where the environment asks for it.
inline bool isFullLength() {
    const char* const wish = std::getenv("TIDEMARK_ENDURANCE");
    return wish && std::string_view(wish) == "full";
}

using Scene = std::vector<TouchEvent>;

// In the order of their names.
inline std::vector<Scene> loadScenes() {
    std::vector<Scene> scenes;
    const std::filesystem::directory_iterator files(TIDEMARK_SCENES_PATH);
    for (const std::filesystem::path& file : std::set<std::filesystem::path>(begin(files), end(files))) {
        std::string error;
        scenes.push_back(loadTouchScript(file, error).value());
    }
    return scenes;
}

// Sets the library up and loads its pictures, which are handed over where they are due.
inline void setUp(WaterHost& host, bool withInk, unsigned due = 0) {
    static const Pictures pictures = {smoothPicture(24, 32, 1), smoothPicture(32, 24, 2), smoothPicture(8, 8, 3)};
    static const PictureSource source = sourceOf(pictures);
    host.setUp(withInk);
    host.loadPictures(source, due);
}
