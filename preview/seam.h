// Makes a clip loop without a jump. The clip starts `fade` frames into the scene; its last frames come from the scene's
// next round and fade into the frames that were skipped at the beginning.
#pragma once

#include <vector>

#include "host/picture.h"

namespace tidemark {

class Seam {
public:
    // Both in frames. With a fade of 0 all frames are unchanged.
    Seam(int round, int fade) : round_(round), fade_(fade) {}

    // Returns the clip's frame for frame 0 to round + fade - 1 of the scene, or null if there is none. Valid until the
    // next call.
    const Picture* shown(int number, const Picture& frame);

private:
    int round_, fade_;
    std::vector<Picture> beginning_;
};

}  // namespace tidemark
