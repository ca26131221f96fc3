// A line of text on a QImage: Qt draws its coverage, the library paints it right into the image's
// pixels.
#include <QColor>
#include <QFont>
#include <QFontMetrics>
#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <algorithm>
#include <vector>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

/// The coverage of a line, and where it stands from the start of the baseline.
struct Mask {
    QImage coverage;
    QPoint place;

    Glyph glyph() const {
        return {place.x(),        place.y(),         coverage.constBits(),
                coverage.width(), coverage.height(), coverage.bytesPerLine()};
    }
};

Mask maskOf(const QString& text, const QFont& font) {
    const QRect box = QFontMetrics(font).boundingRect(text).adjusted(-1, -1, 1, 1);
    Mask mask{QImage(box.size(), QImage::Format_Grayscale8), box.topLeft()};
    mask.coverage.fill(0);
    QPainter painter(&mask.coverage);
    painter.setFont(font);
    painter.setPen(Qt::white);
    painter.drawText(-box.topLeft(), text);
    return mask;
}

/// ARGB32 names a number, whose bytes lie as B, G, R, A in memory; RGBA8888 names the bytes.
PictureView viewOf(QImage& image) {
    const bool isBgra = image.format() == QImage::Format_ARGB32_Premultiplied;
    return {image.bits(), image.width(), image.height(), image.bytesPerLine(),
            isBgra ? PixelOrder::bgra : PixelOrder::rgba};
}

QImage painted(QImage::Format format, const Look& look, const Mask& mask) {
    QImage image(340, 120, format);
    image.fill(QColor(0x41, 0xCD, 0x52));
    check(paint(look, mask.glyph(), viewOf(image), 20, 85).has_value(), "painted");
    return image;
}

/// Both formats hold the bytes of a page.
void checkFormats(const QImage& argb, const QImage& rgba, const Look& look, const Mask& mask) {
    Page page(340, 120, 0x41CD52);
    paint(look, mask.glyph(), page.view(), 20, 85);
    check(std::equal(page.pixels().begin(), page.pixels().end(), rgba.constBits()), "as on a page");
    check(argb.convertToFormat(rgba.format()) == rgba, "the same in both formats");
}

/// Where the coverage is full there is the fill alone.
void checkFill(const QImage& image, const Mask& mask) {
    for (int y = 0; y < mask.coverage.height(); ++y)
        for (int x = 0; x < mask.coverage.width(); ++x)
            if (mask.coverage.constScanLine(y)[x] == 255)
                check(image.pixel(QPoint(20 + x, 85 + y) + mask.place) == 0xFFFFD75E, "the fill");
}

}  // namespace

int main(int argc, char** argv) {
    const QGuiApplication application(argc, argv);
    QFont font("DejaVu Sans", -1, QFont::Bold);
    font.setPixelSize(72);
    const Mask mask = maskOf("QImage", font);
    Look look;
    look.fill(rgb(0xFFD75E))
        .add(OuterShadow(rgb(0)).angle(135).distance(9).size(7).opacity(0.8F))
        .add(Stroke(4, rgb(0x0B3C2D)));

    const QImage argb = painted(QImage::Format_ARGB32_Premultiplied, look, mask);
    const QImage rgba = painted(QImage::Format_RGBA8888_Premultiplied, look, mask);
    checkFormats(argb, rgba, look, mask);
    checkFill(argb, mask);
    check(argb.save("qimage.png"), "a PNG");
    return 0;
}
