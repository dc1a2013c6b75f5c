// One run of the preview: pictures and touches in, frames out.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "host/presets.h"
#include "preview/arguments.h"

// What is left empty is the built-in picture or look, no script, or no such output.
struct PreviewOptions {
    std::string portrait, landscape, light;  // files
    Ground ground = Ground::pool;            // the built-in picture
    Look base;                               // what the file of the look does not name
    std::string look;                        // file
    std::string script;                      // file
    bool rain = false;
    Size size = {540, 960};
    std::optional<double> seconds;  // or the script's length and a little for the water to calm
    int framesPerSecond = 60;
    std::string out;     // directory
    int every = 1;       // frames from one picture in it to the next
    std::string video;   // file
    std::string inside;  // directory, for what lies behind the last frame; with ink only
    std::uint32_t seed = 1;
    bool withInk = false;
    std::optional<InkColor> inkColor;  // instead of the look's own
};

// On failure says why in `error`, and leaves none of its output behind.
bool runPreview(const PreviewOptions& options, std::string& error);
