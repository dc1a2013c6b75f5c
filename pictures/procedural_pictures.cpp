#include "pictures/procedural_pictures.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <future>
#include <vector>

#include "pictures/caustics.h"
#include "pictures/noise.h"
#include "pictures/pebbles.h"
#include "pictures/pool_tiles.h"
#include "pictures/sea_sand.h"

namespace tidemark {

// Compute the caustics in parallel with the ground, except in a browser, where a program has one thread.
#ifdef __EMSCRIPTEN__
constexpr auto kLaunch = std::launch::deferred;
#else
constexpr auto kLaunch = std::launch::async;
#endif

namespace {

// Compresses bright values towards white instead of clipping them.
float expose(float light) {
    return light * (1.0f + light * 0.25f) / (1.0f + light * 0.60f);
}

// The caustics at half the resolution, sampled bilinearly.
float sampleHalf(const std::vector<float>& net, int netWidth, int netHeight, int column, int row) {
    const auto at = [&](int x, int y) {
        return net[static_cast<std::size_t>(
            std::clamp(y, 0, netHeight - 1) * netWidth + std::clamp(x, 0, netWidth - 1))];
    };
    const int x = column / 2;
    const int y = row / 2;
    const int besideX = column % 2 == 0 ? x - 1 : x + 1;
    const int besideY = row % 2 == 0 ? y - 1 : y + 1;
    return 0.5625f * at(x, y) + 0.1875f * (at(besideX, y) + at(x, besideY)) + 0.0625f * at(besideX, besideY);
}

// Returns the colour of the ground under `depth` of water: 0 is shallow and warm, 1 deep and blue-green.
Rgb underWater(Rgb stone, float depth, float caustic) {
    const float sun = (1.30f + 0.28f * std::min(caustic, 3.0f)) * (1.30f - 0.50f * depth);
    return {
        expose(stone.r * sun * (1.20f - 0.80f * depth) + 0.002f),
        expose(stone.g * sun * (1.10f - 0.28f * depth) + 0.003f + 0.016f * depth),
        expose(stone.b * sun * (0.92f + 0.06f * depth) + 0.004f + 0.026f * depth)};
}

// Returns the ground that paintGround(canvas, unit) draws, with water of depthAt(x, y) and caustics over it; x and y
// are from 0 to 1.
template <class PaintGround, class DepthAt>
Picture flood(int width, int height, float netCell, PaintGround paintGround, DepthAt depthAt) {
    const float unit = 0.045f * std::sqrt(static_cast<float>(width) * static_cast<float>(height));
    const int netWidth = (width + 1) / 2;
    const int netHeight = (height + 1) / 2;
    auto futureNet = std::async(kLaunch, causticNet, netWidth, netHeight, unit * netCell, 3U);
    Canvas bed(width, height);
    paintGround(bed, unit);

    const std::vector<float> net = futureNet.get();
    forAllPixels(bed, [&](Rgb& pixel, int column, int row) {
        const float x = static_cast<float>(column) / static_cast<float>(width);
        const float y = static_cast<float>(row) / static_cast<float>(height);
        const float depth = std::clamp(depthAt(x, y), 0.0f, 1.0f);
        pixel = underWater(pixel, depth, sampleHalf(net, netWidth, netHeight, column, row));
    });
    return toPicture(bed);
}

}  // namespace

Picture riverBed(int width, int height) {
    const auto pebbles = [](Canvas& bed, float unit) {
        Random random(5);
        scatterPebbles(bed, unit, random, CloudTile(11));
    };
    return flood(width, height, 0.6f, pebbles, [](float x, float y) { return 0.40f * x + 0.80f * y - 0.10f; });
}

Picture tiledPool(int width, int height) {
    const auto tiles = [](Canvas& bed, float unit) { layTiles(bed, unit, CloudTile(41)); };
    return flood(width, height, 0.8f, tiles, [](float, float y) { return 0.15f + 0.35f * y; });
}

Picture sandyShore(int width, int height) {
    const auto sand = [](Canvas& bed, float unit) {
        Random random(8);
        rakeSand(bed, unit, random, CloudTile(31));
    };
    return flood(width, height, 0.7f, sand, [](float x, float y) { return 0.75f - 0.25f * x - 0.70f * y; });
}

// A flat surface reflects the centre of this picture; slopes reflect the parts around it: the sky with the sun's
// glitter.
Picture waterLight(int side) {
    const CloudTile clouds(23);
    const std::vector<float> glitter = causticNet(side, side, static_cast<float>(side) / 12.0f, 9);
    Canvas sky(side, side);
    forAllPixels(sky, [&](Rgb& pixel, int column, int row) {
        const float cloud = std::clamp(clouds.at(column, row) * 1.6f - 0.3f, 0.0f, 1.0f);
        const float sun = 0.16f * std::min(glitter[static_cast<std::size_t>(row * side + column)], 5.0f);
        pixel = {0.14f + 0.40f * cloud + sun, 0.30f + 0.35f * cloud + sun * 0.97f, 0.52f + 0.26f * cloud + sun * 0.90f};
    });
    return toPicture(sky);
}

}  // namespace tidemark
