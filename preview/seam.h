// A clip that goes round without a jump: what would follow its end turns into its beginning. So the clip begins a
// little into the scene, and it ends with as many frames of the scene's next round, which fade into those that were
// left out.
#pragma once

#include <vector>

#include "host/picture.h"

namespace tidemark {

class Seam {
public:
    // Both counted in frames; without a fade every frame is as it is.
    Seam(int round, int fade) : round_(round), fade_(fade) {}

    // Returns the clip's frame for a frame of the scene, counted from 0 to round + fade: null for nothing. Stays as it
    // is until the next call.
    const Picture* shown(int number, const Picture& frame);

private:
    int round_, fade_;
    std::vector<Picture> beginning_;
};

}  // namespace tidemark
