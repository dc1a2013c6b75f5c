#include "preview/picture_file.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <utility>

#include "preview/ffmpeg.h"

namespace tidemark {

namespace {

// Limit of the decoder's processor time in seconds, ten times what the largest photo needs; a small file can be made to
// take hours.
constexpr int kMostSeconds = 60;

void coverWhite(Picture& picture) {
    for (std::size_t i = 0; i < picture.rgba.size(); i += 4) {
        std::uint8_t* const pixel = &picture.rgba[i];
        const int alpha = std::exchange(pixel[3], std::uint8_t{255});
        for (int k = 0; alpha < 255 && k < 3; ++k) {
            pixel[k] = static_cast<std::uint8_t>((pixel[k] * alpha + 255 * (255 - alpha) + 127) / 255);
        }
    }
}

// Reads one picture in PAM format: a text header, then the pixels.
std::optional<Picture> readPam(std::FILE* stream) {
    Picture picture;
    char end = 0;
    // NOLINTNEXTLINE(cert-err34-c): ffmpeg's numbers fit
    const int count = std::fscanf(
        stream, "P7 WIDTH %d HEIGHT %d DEPTH 4 MAXVAL 255 TUPLTYPE RGB_ALPHA ENDHDR%c", &picture.width, &picture.height,
        &end);
    if (count != 3 || end != '\n') return std::nullopt;
    picture.rgba.resize(4 * static_cast<std::size_t>(picture.width) * static_cast<std::size_t>(picture.height));
    if (std::fread(picture.rgba.data(), 1, picture.rgba.size(), stream) != picture.rgba.size()) return std::nullopt;
    return picture;
}

}  // namespace

std::optional<Picture> loadPicture(const std::string& path, std::string& error, int mostPixels) {
    const auto fail = [&](const std::string& reason) {
        error = "cannot read the picture " + path + ": " + reason;
        return std::nullopt;
    };
    // Reading a pipe could block forever.
    const int input = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    if (input < 0) return fail(std::strerror(errno));
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(fdopen(input, "r"), std::fclose);
    struct stat status;
    if (fstat(input, &status) != 0) return fail(std::strerror(errno));
    if (!S_ISREG(status.st_mode)) return fail("it is not a regular file");

    // ffmpeg reads from standard input, so that it detects the format by content and a playlist cannot open other
    // files.
    const std::string options = "-max_pixels " + std::to_string(mostPixels) +
                                " -i pipe:0 -frames:v 1"
                                " -sws_flags bicubic+accurate_rnd+full_chroma_int -f image2pipe -c:v pam -pix_fmt rgba";
    Ffmpeg ffmpeg;
    if (!ffmpeg.startReading(options, input, kMostSeconds, error)) return fail(error);
    std::optional<Picture> picture = readPam(ffmpeg.pipe());
    if (!ffmpeg.finish(error)) return fail(error);
    if (!picture) return fail("ffmpeg finds no picture in it");
    if (const std::string damage = ffmpeg.complaint(); !damage.empty()) {
        std::fprintf(stderr, "%s is damaged: %s\n", path.c_str(), damage.c_str());
    }
    coverWhite(*picture);
    return picture;
}

bool savePicture(const Picture& picture, const std::string& path, std::string& error) {
    Ffmpeg ffmpeg;
    return ffmpeg.startWriting(picture.width, picture.height, 1, std::string(kPng) + " -f image2pipe", path, error) &&
           ffmpeg.write(picture, error) && ffmpeg.finish(error);
}

}  // namespace tidemark
