// A run without a window: draws a scene and writes its frames.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "host/presets.h"
#include "host/view_size.h"

namespace tidemark {

// Empty paths select the default: a painted picture, the preset's look, no script, no output.
struct PreviewOptions {
    std::string picture, portrait, landscape, light;  // files; `picture` replaces an empty portrait or landscape
    Ground ground = Ground::pool;                     // the painted picture
    Look base;                                        // values that the file `look` does not contain
    std::string look;                                 // file
    std::string script;                               // file
    std::optional<double> rainFrom;                   // seconds from the beginning of each round
    Size size = {540, 960};
    std::optional<double> seconds;  // default: the script and 1.5 seconds
    int framesPerSecond = 60;
    std::string out;           // folder of the frames
    int every = 1;             // write every Nth frame into the folder
    std::string video;         // file
    int crf = 18;              // quality of an MP4, 0 (best) to 51
    std::string still;         // file for one frame
    std::optional<double> at;  // time of that frame in seconds; default: the last one
    std::string fields;        // folder for the pictures of fields.h; requires ink
    bool loop = false;         // make the end continue into the beginning
    bool force = false;        // overwrite existing files
    std::uint32_t seed = 1;
    bool withInk = false;
    std::optional<std::uint32_t> inkColor;  // 0xrrggbb; default: the look's colour

    bool inWindow = false;
    bool fullscreen = false;
    std::string record;  // file for the touches in the window
};

// A limit above all displays and below the drivers' limits.
constexpr int kLongestSide = 8192;

// Runs until the end or Ctrl-C, which keeps the frames drawn so far. Stores one line about the written files in
// `summary`, or on failure the reason in `error`.
bool runPreview(const PreviewOptions& options, std::string& summary, std::string& error);

}  // namespace tidemark
