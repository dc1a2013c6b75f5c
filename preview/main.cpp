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

using namespace tidemark;
namespace fs = std::filesystem;

namespace {

enum Exit { done = 0, failed = 1, wrongUse = 2, endedEarly = 130 };

const std::map<std::string, Ground> kGrounds = {
    {"pool", Ground::pool}, {"river", Ground::river}, {"shore", Ground::shore}};
const std::map<std::string, Quality> kQualities = {
    {"low", Quality::low}, {"medium", Quality::medium}, {"high", Quality::high}};

int fail(Exit code, const std::string& reason) {
    std::fprintf(stderr, "tidemark-preview: %s%s\n", reason.c_str(), code == wrongUse ? "; see --help" : "");
    return code;
}

fs::path sceneNamed(const std::string& name) {
    return fs::path(TIDEMARK_SCENES) / (name + ".touch");
}

// Lists the scenes, each with the first words of its file's comment, the presets and the painted pictures.
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

// Checks a colour and rewrites it as a number that CLI11 can parse.
std::string readColor(std::string& text) {
    const std::string digits = text.substr(text.starts_with('#') ? 1 : 0);
    if (digits.size() != 6 || digits.find_first_not_of("0123456789abcdefABCDEF") != digits.npos) {
        return text + " is not #rrggbb";
    }
    text = "0x" + digits;
    return "";
}

// CLI::Range accepts "nan" and hexadecimal numbers.
std::string readNumber(std::string& text) {
    return text.find_first_not_of("0123456789.") == text.npos ? "" : text + " is not a number above 0";
}

// Returns the reason why two options contradict each other, or an empty string.
std::string contradiction(const PreviewOptions& options) {
    const bool isWide = options.size.width > options.size.height;
    const bool writesClip = !options.video.empty() || !options.out.empty();
    if (options.inWindow) return options.rainFrom.value_or(0.0) > 0.0 ? "--rain N is not for a window" : "";
    if (!options.record.empty()) return "--record is for a --window";
    if (!writesClip && options.still.empty() && options.fields.empty()) {
        return "nothing to do: name a --video, --out, --still or --fields to write, or open a --window";
    }
    // With both pictures given, the view may have either orientation.
    if (isWide && options.landscape.empty() && !options.portrait.empty()) return "--portrait is not for a wide view";
    if (!isWide && options.portrait.empty() && !options.landscape.empty()) return "--landscape is for a wide view";
    if (!options.fields.empty() && !options.withInk) return "--fields needs ink";
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
        std::string("Pictures are all that ffmpeg reads; transparent parts are white.\nKeys in the window: ") +
        kWindowKeys +
        ".\n"
        "Ctrl-C ends a run early, with the frames that it has drawn.\n"
        "Ends with 0 when all is done, 1 when that fails, 2 for a wrong option, 130 after Ctrl-C.");
    app.set_version_flag("--version", "tidemark-preview " TIDEMARK_VERSION, "Print the version");
    app.add_flag_callback(
        "--list", [] { throw CLI::CallForVersion(listNames(), 0); }, "List the scenes, looks and pictures with names");
    // demo.sh puts its own options first; the user's replace them.
    app.option_defaults()->multi_option_policy(CLI::MultiOptionPolicy::TakeLast);
    const auto add = [&](const char* name, auto& value, const char* type, const char* help) {
        return app.add_option(name, value, help)->type_name(type);
    };

    app.option_defaults()->group("Scene");
    std::vector<std::string> presets;
    for (const Preset& named : kPresets) presets.emplace_back(named.name);
    add("--preset", preset, "NAME", "Look, picture, ink and rain with a name")->check(CLI::IsMember(presets));
    CLI::Option* const both =
        add("--picture", picture, "pool|river|shore|FILE", "Picture under the water, painted or a file; default: pool");
    add("--portrait", options.portrait, "FILE", "Picture for a view that is taller than wide")->excludes(both);
    add("--landscape", options.landscape, "FILE", "Picture for a view that is wider than tall")->excludes(both);
    add("--light", options.light, "FILE", "Picture of the light on the waves");
    add("--look", options.look, "FILE",
        "Values of the look, above those of the preset: lines of \"key = number\", as in host/look.properties");
    const CLI::Validator isNumber(readNumber, "");
    CLI::Option* const rain = add("--rain", options.rainFrom, "[N]",
                                  "Let it rain, from second N on; default: throughout if there is no --script")
                                  ->expected(0, 1)
                                  ->check(CLI::Range(0.0, 3600.0))
                                  ->check(isNumber);
    CLI::Option* const ink = add("--ink", options.inkColor, "#rrggbb", "Colour of the ink, each channel at most bf")
                                 ->transform(CLI::Validator(readColor, ""));
    CLI::Option* const withoutInk = app.add_flag("--no-ink", noInk, "Water without ink")->excludes(ink);
    add("--seed", options.seed, "N", "Seed of the random numbers")->capture_default_str();
    CLI::Option* const view = add("--size", size, "WxH", "Size of the view in pixels; default: 540x960")
                                  ->delimiter('x')
                                  ->multi_option_policy(CLI::MultiOptionPolicy::Throw)
                                  ->check(CLI::Range(1, kLongestSide));

    const std::string clip = "What a run without a window draws and writes";
    app.option_defaults()->group(clip);
    const CLI::Range time(0.001, 3600.0);
    add("--script", options.script, "NAME|FILE",
        "Touches to play: a scene, or lines of \"time_ms action x y pressure\"");
    add("--density", density, "N", "Pixels of the display for each density-independent pixel; default: 1")
        ->check(CLI::Range(0.5, 8.0))
        ->check(isNumber);
    add("--quality", quality, "low|medium|high", "Draw at most 1, 2 or 3 pixels for each density-independent pixel")
        ->transform(CLI::CheckedTransformer(kQualities).description(""));
    add("--seconds", options.seconds, "N", "Length of the scene; default: a little more than the script")
        ->check(time)
        ->check(isNumber);
    // The host takes longer frames for a pause.
    CLI::Option* const fps =
        add("--fps", options.framesPerSecond, "N", "Frames per second; default: 60, and 50 for a GIF")
            ->check(CLI::Range(4, 240));
    CLI::Option* const video = add("--video", options.video, "FILE.mp4|.webp|.gif", "Video to write")
                                   ->check(endingIn({".mp4", ".webp", ".gif"}));
    CLI::Option* const crf = add("--crf", options.crf, "N", "Quality of an MP4: less is better and larger; default: 18")
                                 ->check(CLI::Range(0, 51))
                                 ->needs(video);
    app.add_flag("--loop", options.loop, "A clip whose end leads over to its beginning");
    CLI::Option* const out = add("--out", options.out, "FOLDER", "Folder for all frames: frame-0000.png and so on");
    add("--every", options.every, "N", "Write every Nth frame as a picture")
        ->check(CLI::Range(1, 1'000'000))
        ->needs(out);
    CLI::Option* const still = add("--still", options.still, "FILE.png", "One frame to write, the last or that of --at")
                                   ->check(endingIn({".png"}));
    add("--at", options.at, "N", "Seconds to that frame")->check(time)->check(isNumber)->needs(still);
    add("--fields", options.fields, "FOLDER",
        "Folder for pictures of the heights, the flow and the ink behind the last frame")
        ->excludes(withoutInk);

    app.option_defaults()->group("Window");
    app.add_flag("--window", options.inWindow, "Open a window and touch the water with the mouse");
    app.add_flag("--fullscreen", options.fullscreen, "The same on the whole screen")->excludes(view);
    add("--record", options.record, "FILE.touch", "Touch script to write with the touches in the window")
        ->check(endingIn({".touch"}));

    app.option_defaults()->group("Other");
    app.add_flag("--force", options.force, "Overwrite what is there");
    app.add_flag("--verbose", verbose, "Show the library's log");
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success& asked) {
        return app.exit(asked);
    } catch (const CLI::ParseError& problem) {
        return fail(wrongUse, problem.what());
    }

    options.inWindow |= options.fullscreen;
    for (const CLI::Option* const option : app.get_options()) {
        if (!options.inWindow || !*option || option->get_group() != clip) continue;
        return fail(wrongUse, option->get_name() + " is not for a window");
    }
    options.size = {size.first, size.second};
    if (quality) options.size = drawnSize({size.first / density, size.second / density, density}, *quality, 1.0);
    options.withInk = !noInk;
    bool rains = *rain || (options.script.empty() && !options.inWindow);
    for (const Preset& named : kPresets) {
        if (named.name != preset) continue;
        options.base = named.look;
        options.ground = named.ground;
        rains |= named.rain;
        options.withInk = (named.ink || *ink) && !noInk;
    }
    if (const auto ground = kGrounds.find(picture); ground != kGrounds.end()) {
        options.ground = ground->second;
    } else {
        options.picture = picture;
    }
    if (!*fps && options.video.ends_with(".gif")) options.framesPerSecond = 50;
    if (*crf && !options.video.ends_with(".mp4")) return fail(wrongUse, "--crf is for an MP4");
    if (const std::string reason = contradiction(options); !reason.empty()) return fail(wrongUse, reason);
    if (!fs::exists(options.script) && fs::exists(sceneNamed(options.script))) {
        options.script = sceneNamed(options.script);
    }
    if (rains && !options.rainFrom) options.rainFrom = 0.0;
    if (!verbose) quietenLog();

    std::string summary, error;
    const bool isDone = options.inWindow ? runWindow(options, summary, error) : runPreview(options, summary, error);
    if (!isDone) return fail(interrupted() ? endedEarly : failed, error);
    if (!summary.empty()) std::printf("%s\n", summary.c_str());
    return interrupted() && !options.inWindow ? endedEarly : done;
}
