// tidemark-preview: the command line.
#include <CLI/CLI.hpp>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "host/log_filter.h"
#include "preview/interrupt.h"
#include "preview/preview.h"
#include "preview/window.h"

namespace fs = std::filesystem;

namespace {

enum Exit { done = 0, failed = 1, wrongUse = 2, endedEarly = 130 };

const std::map<std::string, Ground> kGrounds = {
    {"pool", Ground::pool}, {"river", Ground::river}, {"shore", Ground::shore}};

int fail(Exit code, const std::string& reason) {
    std::fprintf(stderr, "tidemark-preview: %s%s\n", reason.c_str(), code == wrongUse ? "; see --help" : "");
    return code;
}

fs::path sceneNamed(const std::string& name) {
    return fs::path(TIDEMARK_SCENES) / (name + ".touch");
}

// Each scene with the beginning of its comment.
std::string listNames() {
    const auto row = [](std::string name, std::string_view text) {
        name.resize(std::max<std::size_t>(name.size(), 16), ' ');
        return "  " + name + " " + std::string(text) + "\n";
    };
    std::string list = "Scenes for --script:\n";
    std::error_code ignored;
    std::set<std::string> names;
    for (const auto& file : fs::directory_iterator(TIDEMARK_SCENES, ignored)) names.insert(file.path().stem());
    for (const std::string& name : names) {
        std::string line;
        std::getline(std::ifstream(sceneNamed(name)), line);
        list += row(name, line.substr(std::min<std::size_t>(line.size(), 2), line.find_first_of(":;.") - 2));
    }
    list += "Looks for --preset:\n";
    for (const Preset& preset : kPresets) list += row(std::string(preset.name), preset.title);
    list += "Painted pictures for --picture:\n";
    for (const auto& [name, ground] : kGrounds) list += "  " + name + "\n";
    list.pop_back();
    return list;
}

CLI::Validator endingIn(const std::set<std::string>& endings) {
    return {
        [=](std::string& name) {
            if (endings.contains(fs::path(name).extension())) return std::string();
            return name + " does not end in " + CLI::detail::join(endings, " or ");
        },
        ""};
}

// Leaves a number of the form that the parser knows.
std::string readColor(std::string& text) {
    const std::string digits = text.substr(text.starts_with('#') ? 1 : 0);
    if (digits.size() != 6 || digits.find_first_not_of("0123456789abcdefABCDEF") != digits.npos) {
        return text + " is not #rrggbb";
    }
    text = "0x" + digits;
    return "";
}

// Ranges let through what is not a number.
std::string readNumber(std::string& text) {
    return text.find_first_not_of("0123456789.") == text.npos ? "" : text + " is not a number above 0";
}

// What options say together that none of them says alone; empty when all is well.
std::string contradiction(const PreviewOptions& options) {
    const bool isWide = options.size.width > options.size.height;
    const bool writesClip = !options.video.empty() || !options.out.empty();
    if (options.inWindow) return "";
    if (!options.record.empty()) return "--record is for a --window";
    if (!writesClip && options.still.empty() && options.inside.empty()) {
        return "nothing to do: name a --video, --out, --still or --inside to write, or open a --window";
    }
    if (isWide && !options.portrait.empty()) return "--portrait is for a view that is taller than this one is wide";
    if (!isWide && !options.landscape.empty()) return "--landscape is for a view that is wider than this one is tall";
    if (!options.inside.empty() && !options.withInk) return "--inside needs ink";
    if (options.loop && !writesClip) return "--loop is for a --video or --out";
    if (options.at && options.seconds && *options.at > *options.seconds) return "--at is after the end of --seconds";
    if (options.framesPerSecond > 50 && options.video.ends_with(".gif")) {
        return "--fps: a GIF shows at most 50 frames a second";
    }
    return "";
}

}  // namespace

int main(int argc, char** argv) {
    PreviewOptions options;
    std::pair<int, int> size = {options.size.width, options.size.height};
    double density = 1.0;
    std::optional<Quality> quality;
    std::string preset, picture;
    bool noInk = false;
    bool verbose = false;

    CLI::App app("Draws rippling water over a picture into a video, PNG files or a window.");
    app.get_formatter()->column_width(28);
    app.footer(
        std::string("Keys in the window: ") + kWindowKeys +
        ".\n"
        "Ctrl-C ends a run early, with the frames that it has drawn.\n"
        "Ends with 0 when all is done, 1 when that fails, 2 for a wrong option, 130 after Ctrl-C.");
    app.set_version_flag("--version", "tidemark-preview " TIDEMARK_VERSION, "Print the version");
    app.add_flag_callback(
        "--list", [] { throw CLI::CallForVersion(listNames(), 0); }, "List the scenes, looks and pictures with names");
    // So that a script's own options may come first.
    app.option_defaults()->multi_option_policy(CLI::MultiOptionPolicy::TakeLast);

    app.option_defaults()->group("Scene");
    std::vector<std::string> presets;
    for (const Preset& named : kPresets) presets.emplace_back(named.name);
    app.add_option("--preset", preset, "Look, picture, ink and rain with a name")
        ->check(CLI::IsMember(presets))
        ->type_name("NAME");
    CLI::Option* const both =
        app.add_option("--picture", picture, "Picture under the water, painted or a file; default: pool")
            ->type_name("pool|river|shore|FILE");
    app.add_option("--portrait", options.portrait, "Picture for a view that is taller than wide")
        ->excludes(both)
        ->type_name("FILE");
    app.add_option("--landscape", options.landscape, "Picture for a view that is wider than tall")
        ->excludes(both)
        ->type_name("FILE");
    app.add_option("--light", options.light, "Picture of the light on the waves")->type_name("FILE");
    app.add_option(
           "--look", options.look,
           "Values of the look, above those of the preset: lines of \"key = number\", as in host/look.properties")
        ->type_name("FILE");
    CLI::Option* const script =
        app.add_option(
               "--script", options.script, "Touches to play: a scene, or lines of \"time_ms action x y pressure\"")
            ->type_name("NAME|FILE");
    app.add_flag("--rain", options.rain, "Let it rain; without --script it always does");
    CLI::Option* const ink =
        app.add_option("--ink", options.inkColor, "Colour of the ink that touches drop, each channel at most bf")
            ->transform(CLI::Validator(readColor, "", "color"))
            ->type_name("#rrggbb");
    CLI::Option* const withoutInk = app.add_flag("--no-ink", noInk, "Water without ink")->excludes(ink);
    app.add_option("--seed", options.seed, "Seed of the random numbers")->capture_default_str();

    app.option_defaults()->group("View");
    CLI::Option* const view = app.add_option("--size", size, "Size of the view in pixels; default: 540x960")
                                  ->delimiter('x')
                                  ->multi_option_policy(CLI::MultiOptionPolicy::Throw)
                                  ->check(CLI::Range(1, kLongestSide))
                                  ->type_name("WxH");
    std::vector<CLI::Option*> recorded = {script};
    recorded.push_back(app.add_option("--density", density, "Pixels of the display for each density-independent pixel")
                           ->check(CLI::Range(0.5, 8.0))
                           ->check(CLI::Validator(readNumber, ""))
                           ->capture_default_str());
    recorded.push_back(
        app.add_option("--quality", quality, "Draw at most 1, 2 or 3 pixels for each density-independent pixel")
            ->transform(CLI::CheckedTransformer(
                            std::map<std::string, Quality>{
                                {"low", Quality::low}, {"medium", Quality::medium}, {"high", Quality::high}})
                            .description(""))
            ->type_name("low|medium|high"));
    const auto seconds = [&](const char* name, std::optional<double>& time, const char* help) {
        recorded.push_back(app.add_option(name, time, help)
                               ->check(CLI::Range(0.001, 3600.0))
                               ->check(CLI::Validator(readNumber, ""))
                               ->type_name("SECONDS"));
        return recorded.back();
    };
    seconds("--seconds", options.seconds, "Length of the scene; default: a little more than the script");
    // The host takes longer frames for a pause.
    CLI::Option* const fps = app.add_option(
                                    "--fps", options.framesPerSecond,
                                    "Frames per second; default: 60, and 50 for a GIF, which shows no more")
                                 ->check(CLI::Range(4, 240));
    recorded.push_back(fps);

    app.option_defaults()->group("Output");
    const auto output = [&](const char* name, std::string& path, const char* help) {
        recorded.push_back(app.add_option(name, path, help));
        return recorded.back();
    };
    CLI::Option* const video = output("--video", options.video, "Video to write")
                                   ->check(endingIn({".mp4", ".webp", ".gif"}))
                                   ->type_name("FILE.mp4|.webp|.gif");
    CLI::Option* const crf = app.add_option("--crf", options.crf, "Quality of an MP4: less is better and larger")
                                 ->check(CLI::Range(0, 51))
                                 ->needs(video)
                                 ->capture_default_str();
    CLI::Option* const out =
        output("--out", options.out, "Folder for all frames: frame-0000.png and so on")->type_name("FOLDER");
    recorded.push_back(app.add_option("--every", options.every, "Write every Nth frame as a picture")
                           ->check(CLI::Range(1, 1'000'000))
                           ->needs(out)
                           ->type_name("N"));
    CLI::Option* const still = output("--still", options.still, "One frame to write, the last one or that of --at")
                                   ->check(endingIn({".png"}))
                                   ->type_name("FILE.png");
    seconds("--at", options.at, "Time of that frame")->needs(still);
    CLI::Option* const inside = output(
                                    "--inside", options.inside,
                                    "Folder for pictures of the heights, the flow and the ink behind the last frame")
                                    ->excludes(withoutInk)
                                    ->type_name("FOLDER");
    recorded.push_back(crf);
    recorded.push_back(inside);
    recorded.push_back(app.add_flag("--loop", options.loop, "A clip whose end leads over to its beginning"));
    app.add_flag("--force", options.force, "Overwrite what is there");

    app.option_defaults()->group("Window");
    app.add_flag("--window", options.inWindow, "Open a window and touch the water with the mouse");
    app.add_flag("--fullscreen", options.fullscreen, "The same on the whole screen")->excludes(view);
    app.add_option("--record", options.record, "Touch script to write with the touches in the window")
        ->check(endingIn({".touch"}))
        ->type_name("FILE.touch");

    app.option_defaults()->group("Other");
    app.add_flag("--verbose", verbose, "Show the library's log");
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success& asked) {
        return app.exit(asked);
    } catch (const CLI::ParseError& problem) {
        return fail(wrongUse, problem.what());
    }

    options.inWindow |= options.fullscreen;
    for (const CLI::Option* const option : recorded) {
        if (*option && options.inWindow) return fail(wrongUse, option->get_name() + " is not for a window");
    }
    options.size = {size.first, size.second};
    if (quality) options.size = drawnSize({size.first / density, size.second / density, density}, *quality, 1.0);
    options.withInk = !noInk;
    for (const Preset& named : kPresets) {
        if (named.name != preset) continue;
        options.base = named.look;
        options.ground = named.ground;
        options.rain |= named.rain;
        options.withInk = (named.ink || *ink) && !noInk;
    }
    const auto ground = kGrounds.find(picture);
    if (ground != kGrounds.end())
        options.ground = ground->second;
    else
        options.picture = picture;
    if (!*fps && options.video.ends_with(".gif")) options.framesPerSecond = 50;
    if (*crf && !options.video.ends_with(".mp4")) return fail(wrongUse, "--crf is for an MP4");
    if (const std::string reason = contradiction(options); !reason.empty()) return fail(wrongUse, reason);
    if (!fs::exists(options.script) && fs::exists(sceneNamed(options.script))) {
        options.script = sceneNamed(options.script);
    }
    if (options.script.empty() && !options.inWindow) options.rain = true;
    if (!verbose) quietenLog();

    std::string summary, error;
    const bool isDone = options.inWindow ? runWindow(options, summary, error) : runPreview(options, summary, error);
    if (!isDone) return fail(interrupted() ? endedEarly : failed, error);
    if (!summary.empty()) std::printf("%s\n", summary.c_str());
    return interrupted() && !options.inWindow ? endedEarly : done;
}
