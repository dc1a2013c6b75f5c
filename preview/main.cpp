// tidemark-preview: the command line.
#include <CLI/CLI.hpp>

#include <cstdio>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "host/log_filter.h"
#include "preview/preview.h"
#include "preview/window.h"

namespace {

int fail(const std::string& reason) {
    std::fprintf(stderr, "tidemark-preview: %s\n", reason.c_str());
    return 1;
}

}  // namespace

int main(int argc, char** argv) {
    PreviewOptions options;
    std::string size = "540x960";
    double density = 1.0;
    std::optional<Quality> quality;
    std::string preset;
    std::optional<Ground> ground;
    std::string ink;
    bool noInk = false;
    bool verbose = false;
    bool inWindow = false;

    CLI::App app("Draws rippling water over pictures into PNG files and a video, or in a window.");
    app.get_formatter()->column_width(24);
    const auto file = [&](const char* name, std::string& path, const char* help) {
        app.add_option(name, path, help)->type_name("FILE");
    };
    std::vector<std::string> presets;
    for (const Preset& named : kPresets) presets.emplace_back(named.name);
    app.add_option("--preset", preset, "Look, ground, ink and rain with a name")
        ->check(CLI::IsMember(presets))
        ->type_name("NAME");
    app.add_option("--ground", ground, "Painted picture under the water; default: pool")
        ->transform(CLI::CheckedTransformer(
            std::map<std::string, Ground>{{"pool", Ground::pool}, {"river", Ground::river}, {"shore", Ground::shore}}))
        ->type_name("pool|river|shore");
    file("--portrait", options.portrait, "Picture under the water in portrait (PNG or JPEG)");
    file("--landscape", options.landscape, "Picture under the water in landscape (PNG or JPEG)");
    file("--light", options.light, "Picture of the light on the waves (PNG or JPEG)");
    file(
        "--look", options.look,
        "Values of the look, above those of the preset: lines of \"key = number\", as in host/look.properties");
    file("--script", options.script, "Touches to play: lines of \"time_ms action x y pressure\"");
    app.add_flag("--rain", options.rain, "Let it rain; without --script it always does");
    app.add_option("--size", size, "Size of the view in pixels")->type_name("WxH")->capture_default_str();
    app.add_option("--density", density, "Pixels of the display for each density-independent pixel")
        ->check(CLI::Range(0.5, 8.0))
        ->capture_default_str();
    app.add_option("--quality", quality, "Draw at most 1, 2 or 3 pixels for each density-independent pixel")
        ->transform(CLI::CheckedTransformer(std::map<std::string, Quality>{
            {"low", Quality::low}, {"medium", Quality::medium}, {"high", Quality::high}}))
        ->type_name("low|medium|high");
    app.add_option(
        "--seconds", options.seconds, "Length of the scene in seconds; default: a little more than the script");
    app.add_option("--fps", options.framesPerSecond, "Frames per second")->capture_default_str();
    app.add_option(
           "--out", options.out,
           "Directory for frame-0000.png and so on; default: \"out\" where nothing else is written")
        ->type_name("DIR");
    app.add_option("--every", options.every, "Write every Nth frame as a picture")->check(CLI::PositiveNumber);
    file("--video", options.video, "Video to write: a name ending in .mp4, .webp or .gif");
    CLI::Option* inside = app.add_option(
                                 "--inside", options.inside,
                                 "Directory for pictures of the heights, the flow and the ink behind the last frame")
                              ->type_name("DIR");
    app.add_option("--seed", options.seed, "Seed of the random numbers")->capture_default_str();
    CLI::Option* inkOption = app.add_option("--ink", ink, "Colour of the ink that touches drop")->type_name("#rrggbb");
    app.add_flag("--no-ink", noInk, "Water without ink")->excludes(inkOption)->excludes(inside);
    CLI::Option* window =
        app.add_flag("--window", inWindow, "Open a window instead and touch the water with the mouse");
    for (const char* recorded :
         {"--density", "--quality", "--script", "--seconds", "--fps", "--out", "--every", "--video", "--inside"}) {
        window->excludes(app.get_option(recorded));
    }
    app.add_flag("--verbose", verbose, "Show the library's log");
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success& help) {
        return app.exit(help);
    } catch (const CLI::ParseError& problem) {
        fail(std::string(problem.what()) + "; see --help");
        return 2;
    }

    std::string error;
    const std::optional<Size> parsedSize = parseSize(size, error);
    if (!parsedSize) return fail("--size " + error);
    options.size = *parsedSize;
    if (quality) {
        const auto [width, height] = *parsedSize;
        options.size = drawnSize({width / density, height / density, density}, *quality, 1.0);
    }
    if (options.seconds && !(*options.seconds > 0.0 && *options.seconds <= 3600.0)) {
        return fail("--seconds must be above 0 and at most 3600");
    }
    // The host takes longer frames for a pause.
    if (options.framesPerSecond < 4 || options.framesPerSecond > 240) return fail("--fps must be 4 to 240");
    if (*inkOption && !(options.inkColor = parseInkColor(ink, error))) return fail("--ink " + error);
    options.withInk = !noInk;
    for (const Preset& named : kPresets) {
        if (named.name != preset) continue;
        options.base = named.look;
        options.ground = named.ground;
        options.rain |= named.rain;
        options.withInk = (named.ink || *inkOption) && !noInk;
    }
    options.ground = ground.value_or(options.ground);
    if (!verbose) quietenLog();

    if (inWindow) return runWindow(options, error) ? 0 : fail(error);
    if (options.script.empty()) options.rain = true;
    if (options.out.empty() && options.video.empty() && options.inside.empty()) options.out = "out";
    return runPreview(options, error) ? 0 : fail(error);
}
