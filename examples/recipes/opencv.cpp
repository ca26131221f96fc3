// A title over a frame of a film in OpenCV: its own letters are the coverage, B, G, R its pixels.
#include <algorithm>
#include <opencv2/core/mat.hpp>
#include <opencv2/imgproc.hpp>
#include <optional>

#include "recipe.h"

using namespace VFontEffect;

namespace {

constexpr int kThickness = 9;

/// The coverage of a line, with room on all sides for the thickness of its strokes.
cv::Mat maskOf(const char* text, double scale) {
    int below = 0;  // the baseline
    const cv::Size size = cv::getTextSize(text, cv::FONT_HERSHEY_SIMPLEX, scale, kThickness, &below);
    cv::Mat mask(size.height + below + 2 * kThickness, size.width + 2 * kThickness, CV_8UC1,
                 cv::Scalar(0));
    cv::putText(mask, text, {kThickness, kThickness + size.height}, cv::FONT_HERSHEY_SIMPLEX, scale,
                cv::Scalar(255), kThickness, cv::LINE_AA);
    return mask;
}

Glyph glyphOf(const cv::Mat& mask) {
    return {0, 0, mask.data, mask.cols, mask.rows, static_cast<std::ptrdiff_t>(mask.step)};
}

/// Of a CV_8UC4 of premultiplied B, G, R, A.
PictureView viewOf(cv::Mat& mat) {
    return {mat.data, mat.cols, mat.rows, static_cast<std::ptrdiff_t>(mat.step), PixelOrder::bgra};
}

/// Lays the painted mask over a CV_8UC3, its top left corner at (x, y). Only the box of the picture is
/// given a fourth channel, and loses it again.
void layOver(cv::Mat& frame, const Look& look, const cv::Mat& mask, int x, int y) {
    const Margins margins = look.margins();
    const cv::Rect box =
        cv::Rect(x - margins.left, y - margins.top, margins.left + mask.cols + margins.right,
                 margins.top + mask.rows + margins.bottom) &
        cv::Rect(0, 0, frame.cols, frame.rows);
    if (box.empty()) return;
    cv::Mat part;
    cv::cvtColor(frame(box), part, cv::COLOR_BGR2BGRA);
    paint(look, glyphOf(mask), viewOf(part), x - box.x, y - box.y);
    cv::cvtColor(part, frame(box), cv::COLOR_BGRA2BGR);
}

/// A frame of a film: here a ramp from left to right.
cv::Mat filmFrame() {
    cv::Mat frame(140, 420, CV_8UC3);
    for (int y = 0; y < frame.rows; ++y)
        for (int x = 0; x < frame.cols; ++x)
            frame.at<cv::Vec3b>(y, x) = cv::Vec3b(0x60, static_cast<unsigned char>(x / 2), 0x20);
    return frame;
}

/// A pixel of the picture, whose origin stands at (40, 30) of the frame; clear beside it.
cv::Vec4b pixelOf(const Picture& picture, int x, int y) {
    const int column = x - 40 - picture.left();
    const int row = y - 30 - picture.top();
    if (column < 0 || column >= picture.width() || row < 0 || row >= picture.height()) return {};
    return cv::Vec4b(picture.data() + row * picture.stride() + column * 4);
}

/// Each channel is over + under * (255 - alpha) / 255 of the same picture, to the nearest.
void checkLaid(const cv::Mat& seen, const cv::Mat& under, const Picture& picture) {
    for (int y = 0; y < seen.rows; ++y)
        for (int x = 0; x < seen.cols; ++x) {
            const cv::Vec4b over = pixelOf(picture, x, y);
            for (int channel = 0; channel < 3; ++channel) {
                const int through =
                    (under.at<cv::Vec3b>(y, x)[2 - channel] * (255 - over[3]) * 2 + 255) / 510;
                check(seen.at<cv::Vec3b>(y, x)[2 - channel] == std::min(255, over[channel] + through),
                      "over + under * (255 - alpha) / 255");
            }
        }
}

}  // namespace

int main() {
    Look look;
    look.fill(rgb(0xFFFFFF)).add(OuterGlow(16, rgb(0xFF3D7F))).add(Stroke(3, rgb(0x5A0F35)));
    cv::Mat frame = filmFrame();
    const cv::Mat mask = maskOf("OpenCV", 2.4);
    layOver(frame, look, mask, 40, 30);

    const std::optional<Picture> picture = paint(look, glyphOf(mask));
    check(picture.has_value(), "a picture");
    checkLaid(frame, filmFrame(), *picture);
    Page page(frame.cols, frame.rows, 0);
    cv::Mat seen(frame.rows, frame.cols, CV_8UC4, page.view().data);
    cv::cvtColor(frame, seen, cv::COLOR_BGR2RGBA);
    check(page.writePng("opencv.png"), "a PNG");
    return 0;
}
