// The number of pixels that are drawn for a view.
#pragma once

namespace tidemark {

enum class Quality { automatic = 0, low = 1, medium = 2, high = 3 };

struct Size {
    int width, height;

    bool operator==(const Size&) const = default;
};

struct ViewSize {
    double width = 0.0;  // density-independent pixels
    double height = 0.0;
    double density = 1.0;  // display pixels per density-independent pixel

    bool operator==(const ViewSize&) const = default;
};

// Returns the size in pixels at which a view is drawn. Ink strokes have a fixed width in pixels, so the number of drawn
// pixels per density-independent pixel determines their width on the screen: at most 1, 2 and 3 for low, medium and
// high quality. Automatic quality draws the share `resolution` of medium.
Size drawnSize(const ViewSize& view, Quality quality, double resolution);

}  // namespace tidemark
