#include "host/look_file.h"

#include <gtest/gtest.h>

#include <cmath>
#include <sstream>

#include "host/look_values.h"
#include "host/presets.h"

using namespace tidemark;

static std::optional<Look> read(const std::string& text, std::string& error) {
    std::istringstream stream(text);
    return parseLook(stream, "a.look", error);
}

TEST(LookFile, ChangesWhatItNamesAndNothingElse) {
    std::string error;
    const std::optional<Look> look = read("# calm\r\n\n  damping=0.9\r\nmeshVertices = 64\ndamping = 0.95", error);
    ASSERT_TRUE(look) << error;
    EXPECT_EQ(look->damping, 0.95f);
    EXPECT_EQ(look->meshVertices, 64);
    EXPECT_EQ(look->waveSpeed, Look{}.waveSpeed);
}

TEST(LookFile, NamesTheLineThatIsWrong) {
    const std::string longName = std::string(100, 'a') + " = 1";
    const std::string beginning = '"' + std::string(60, 'a') + "...\"";
    for (const auto& [line, reason] :
         {std::pair{"damping 0.9", "key = number"},
          {"dampening = 0.9", "dampening"},
          {"damping =", "damping"},
          {"damping = 0.9f", "0.9f"},
          {"damping = nan", "nan"},
          {"damping = \x1b[7m\xff", R"(takes no "\x1b[7m\xff")"},
          {longName.c_str(), beginning.c_str()},
          {"damping = 0.9 0.9", "damping"},
          {"damping = 1.001", "0 to 1"},
          {"damping = -0.001", "0 to 1"},
          {"meshVertices = 64.5", "64.5"},
          {"meshVertices = 257", "0 to 256"},
          {"meshVertices = 99999999999", "meshVertices"}}) {
        std::string error;
        EXPECT_FALSE(read("waveSpeed = 0.5\npictureZoom = 0.1\n" + std::string(line) + "\n", error)) << line;
        EXPECT_EQ(error.rfind("a.look:3: ", 0), 0U) << error;
        EXPECT_NE(error.find(reason), std::string::npos) << error;
    }
}

TEST(LookValues, OfThePresetsAreWithinTheirLimits) {
    for (const Preset& preset : kPresets) {
        const LookField* const invalid = firstInvalid(preset.look);
        EXPECT_EQ(invalid, nullptr) << preset.name << ": " << invalid->name;
    }
}

TEST(LookValues, NameWhatIsBeyondItsLimits) {
    Look look;
    look.dropRadius = 0.3f;  // the float nearest to the limit is above it
    EXPECT_EQ(firstInvalid(look), nullptr);
    look.inkBlue = std::nanf("");
    look.framesToFade = -1;
    const LookField* const invalid = firstInvalid(look);
    ASSERT_NE(invalid, nullptr);
    EXPECT_EQ(invalid->name, "inkBlue");
    EXPECT_EQ(fieldNamed("inkblue"), nullptr);
}
