// One run of the preview: pictures and touches in, frames out.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "host/presets.h"
#include "host/view_size.h"

namespace tidemark {

// An empty picture means the painted one, an empty look that of the preset, an empty script none, an empty output none.
struct PreviewOptions {
    std::string picture, portrait, landscape, light;  // files; the first where the next two are empty
    Ground ground = Ground::pool;                     // the painted picture
    Look base;                                        // what the file of the look does not name
    std::string look;                                 // file
    std::string script;                               // file
    std::optional<double> rainFrom;                   // seconds from the beginning of each round
    Size size = {540, 960};
    std::optional<double> seconds;  // or the script's length and a little for the water to calm
    int framesPerSecond = 60;
    std::string out;           // folder
    int every = 1;             // frames from one picture in it to the next
    std::string video;         // file
    int crf = 18;              // quality of an MP4, 0 to 51; less is better
    std::string still;         // file, for one frame
    std::optional<double> at;  // seconds to that, or the last one
    std::string inside;        // folder, for what lies behind the last frame; with ink only
    bool loop = false;         // the end leads over to the beginning
    bool force = false;        // overwrite
    std::uint32_t seed = 1;
    bool withInk = false;
    std::optional<std::uint32_t> inkColor;  // 0xrrggbb, instead of the look's own

    bool inWindow = false;
    bool fullscreen = false;
    std::string record;  // file, for the touches in the window
};

// More than any screen, and still within what drivers draw.
constexpr int kLongestSide = 8192;

// On failure says why in `error`. Otherwise `summary` is a line that tells what was written. Ctrl-C ends the run early,
// with what was drawn until then.
bool runPreview(const PreviewOptions& options, std::string& summary, std::string& error);

}  // namespace tidemark
