// How many pixels a view is drawn with.
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
    double density = 1.0;  // pixels of the display for each of them

    bool operator==(const ViewSize&) const = default;
};

// The ink's strokes are so many pixels wide, so their width on a screen follows from the pixels that are drawn for a
// density-independent one: at most 1, 2 and 3 for low, medium and high; automatic begins with that of medium, of which
// `resolution` is a share.
Size drawnSize(const ViewSize& view, Quality quality, double resolution);

}  // namespace tidemark
