// Where finished frames go. A sink that is destroyed before it has finished takes back all that it wrote.
#pragma once

#include <memory>
#include <string>

#include "host/picture.h"

class FrameSink {
public:
    virtual ~FrameSink() = default;

    // Both say why in `error` on failure.
    virtual bool write(const Picture& frame, std::string& error) = 0;
    virtual bool finish(std::string& error) = 0;
};

// Writes PNG files into a directory, which it makes if need be; `nameOf` gives the name of each frame, counted from 0.
// Null, with the reason in `error`, when the directory cannot be written.
std::unique_ptr<FrameSink> openPngSink(
    const std::string& directory, std::string (*nameOf)(int frame), std::string& error);

// Writes an MP4, WebP or GIF, as the file's ending says, through ffmpeg. The file appears once it is whole.
std::unique_ptr<FrameSink> openVideoSink(
    const std::string& file, int width, int height, int framesPerSecond, std::string& error);
