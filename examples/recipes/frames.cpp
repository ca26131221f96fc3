// Frames into FFmpeg, through pipes: words whose glow pulses, stored with their alpha and laid over a
// film.
#include <algorithm>
#include <csignal>
#include <cstdio>
#include <string>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

constexpr int kWidth = 360;
constexpr int kHeight = 120;
constexpr int kFrames = 50;

using Frame = std::vector<unsigned char>;  // premultiplied R, G, B, A

const std::string kFromPipe = "-f rawvideo -pixel_format rgba -video_size 360x120 -framerate 25 -i - ";

/// A film that keeps the alpha holds straight pixels: it takes the frames that straight() has made.
const std::string kStore = "ffmpeg -v error " + kFromPipe + "-c:v png -y frames.mov";

/// Over a film they go as they are. Without alpha=premultiplied their soft edges would be dark.
const std::string kOver =
    "ffmpeg -v error -f lavfi -i color=0x204060:size=360x120:rate=25,format=rgb24 " + kFromPipe +
    "-filter_complex '[0][1]overlay=format=rgb:alpha=premultiplied:shortest=1' "
    "-c:v png -y over.mov";

/// The glow grows from 4 pixels to 28 and shrinks again.
Look lookOf(int frame) {
    const int size = 4 + std::min(frame, kFrames - 1 - frame);
    return Look()
        .fill(rgb(0xFFF6D8))
        .add(OuterGlow(static_cast<float>(size), rgb(0xFF9A1F)))
        .add(Stroke(2, rgb(0xB34700)));
}

/// The frame with its alpha divided out.
Frame straight(Frame frame) {
    for (std::size_t at = 0; at < frame.size(); ++at) {
        const int alpha = frame[at | 3U];
        if (at % 4 == 3 || alpha == 0) continue;
        frame[at] = static_cast<unsigned char>(std::min(255, (frame[at] * 255 + alpha / 2) / alpha));
    }
    return frame;
}

/// Hands the frames to the command; false when that has failed.
bool pipeInto(const std::string& command, const std::vector<Frame>& frames) {
    std::FILE* pipe = popen(command.c_str(), "w");
    if (pipe == nullptr) return false;
    std::signal(SIGPIPE, SIG_IGN);  // a command that ends early would end this program, too
    std::size_t written = 0;
    for (const Frame& frame : frames)
        written += std::fwrite(frame.data(), frame.size(), 1, pipe);
    return pclose(pipe) == 0 && written == frames.size();
}

std::vector<Frame> paintFrames(const Line& line) {
    std::vector<Frame> frames;
    for (int i = 0; i < kFrames; ++i) {
        frames.emplace_back(4 * kWidth * kHeight);  // clear
        paint(lookOf(i), line.glyphs, {frames.back().data(), kWidth, kHeight}, 30, 80);
    }
    return frames;
}

/// All frames of a film, straight.
std::vector<Frame> framesOf(const std::string& film) {
    const std::string command = "ffmpeg -nostdin -v error -i " + film + " -f rawvideo -pix_fmt rgba -";
    std::FILE* pipe = popen(command.c_str(), "r");
    check(pipe != nullptr, "a pipe");
    std::vector<Frame> frames;
    Frame frame(4 * kWidth * kHeight);
    while (std::fread(frame.data(), frame.size(), 1, pipe) == 1)
        frames.push_back(frame);
    check(pclose(pipe) == 0, "a film that can be read");
    return frames;
}

/// The film holds what the library lays over a page. Writes one of its frames as a PNG.
void checkLaid(const Line& line, const std::vector<Frame>& laid) {
    check(laid.size() == kFrames, "as many frames as painted");
    for (int i = 0; i < kFrames; ++i) {
        Page page(kWidth, kHeight, 0x204060);
        paint(lookOf(i), line.glyphs, page.view(), 30, 80);
        check(laid[static_cast<std::size_t>(i)] == page.pixels(), "as on a page");
        if (i == kFrames / 2) check(page.writePng("frames.png"), "a PNG");
    }
}

}  // namespace

int main() {
    const Line line = Font(kFont, 64).line("FFmpeg");
    const std::vector<Frame> frames = paintFrames(line);
    std::vector<Frame> stored;
    for (const Frame& frame : frames)
        stored.push_back(straight(frame));
    check(pipeInto(kStore, stored), "a film with alpha");
    check(framesOf("frames.mov") == stored, "the film holds the frames");

    check(!pipeInto("false", frames), "a command that fails is told of");
    check(pipeInto(kOver, frames), "a film with words over it");
    checkLaid(line, framesOf("over.mov"));
    return 0;
}
