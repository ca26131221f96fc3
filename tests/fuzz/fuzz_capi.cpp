/// Any sequence of calls of the C face: looks, painters and pictures with null pointers, odd sizes and
/// strides, and views within buffers that hold exactly their bytes. A finding is whatever a sanitizer
/// reports, a call that fails and changes something, one that paints beyond what it says, that says of
/// another box than the margins make of the glyphs, or that paints otherwise where a view ends.
#include <voreleffect/voreleffect_c.h>

#include <algorithm>
#include <array>
#include <climits>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <vector>

#include "decoder.h"
#include "level_of_input.h"
#include "pixels.h"

namespace {

using vorel_fuzz::Decoder;

constexpr int kMostCalls = 60;
constexpr int kMostPaints = 6;
constexpr int kLongestGlyph = 40;
constexpr int kLongestView = 70;
constexpr size_t kLooks = 3;

void require(bool holds) {
    if (!holds) std::abort();
}

/// Rows of pixels as a caller may tell of them; the buffer has their bytes and none more.
struct Rows {
    int32_t width = 0;
    int32_t height = 0;
    ptrdiff_t stride = 0;
    std::vector<uint8_t> bytes;
    bool isReadable = false;  ///< with all rows in the bytes
    bool isNull = false;

    uint8_t* data() { return isNull ? nullptr : bytes.data(); }
};

/// Glyphs with their coverage.
struct Line {
    std::vector<Rows> rows;
    std::vector<vorel_glyph> glyphs;
    bool isNull = false;

    const vorel_glyph* data() const { return isNull ? nullptr : glyphs.data(); }
};

/// A box whose sides may lie beyond an int.
struct Reach {
    int64_t left = 0;
    int64_t top = 0;
    int64_t right = 0;
    int64_t bottom = 0;

    bool isEmpty() const { return right <= left || bottom <= top; }
    /// Makes it hold the other one, too.
    void add(const Reach& other) {
        if (other.isEmpty()) return;
        *this = isEmpty() ? other
                          : Reach{std::min(left, other.left), std::min(top, other.top),
                                  std::max(right, other.right), std::max(bottom, other.bottom)};
    }
    /// With the margins, moved; empty when it was.
    Reach with(const vorel_margins& margins, int32_t x, int32_t y) const {
        if (isEmpty()) return {};
        return {left - margins.left + x, top - margins.top + y, right + margins.right + x,
                bottom + margins.bottom + y};
    }
    Reach within(const Rows& rows) const {
        const Reach both = {std::max<int64_t>(left, 0), std::max<int64_t>(top, 0),
                            std::min<int64_t>(right, rows.width),
                            std::min<int64_t>(bottom, rows.height)};
        return both.isEmpty() ? Reach{} : both;
    }
    bool isThat(const Reach& other) const {
        return left == other.left && top == other.top && right == other.right && bottom == other.bottom;
    }
    bool isThat(const vorel_box& box) const {
        return isThat(Reach{box.left, box.top, box.right, box.bottom});
    }
};

Reach reachOf(const Line& line) {
    Reach all;
    for (const vorel_glyph& glyph : line.glyphs) {
        const int64_t x = glyph.x;
        const int64_t y = glyph.y;
        all.add({x, y, x + glyph.width, y + glyph.height});
    }
    return all;
}

/// What the looks touch of a page, each by its own margins.
Reach touchedBy(const std::vector<vorel_look*>& looks, const Line& line, const Rows& page, int32_t x,
                int32_t y) {
    Reach all;
    for (const vorel_look* look : looks) {
        vorel_margins margins = {};
        require(vorel_look_margins(look, &margins) == VOREL_OK);
        all.add(reachOf(line).with(margins, x, y).within(page));
    }
    return all;
}

/// How much wider a framed page is on each side.
constexpr int kFrame = 5;

/// The page, which is readable, within a larger one that is clear around it.
Rows framed(const Rows& page) {
    Rows larger;
    larger.width = page.width + 2 * kFrame;
    larger.height = page.height + 2 * kFrame;
    larger.bytes.resize(size_t{4} * static_cast<size_t>(larger.width) *
                        static_cast<size_t>(larger.height));
    const ptrdiff_t step = page.stride == 0 ? ptrdiff_t{4} * page.width : page.stride;
    for (int y = 0; y < page.height; ++y) {
        const auto row = page.bytes.begin() + y * step;
        std::copy_n(row, 4 * page.width,
                    larger.bytes.begin() + 4 * ((y + kFrame) * larger.width + kFrame));
    }
    return larger;
}

/// Whether the page is what stands in the frame.
bool standsIn(const Rows& frame, const Rows& page) {
    const ptrdiff_t step = page.stride == 0 ? ptrdiff_t{4} * page.width : page.stride;
    for (int y = 0; y < page.height; ++y) {
        const auto row = page.bytes.begin() + y * step;
        if (!std::equal(row, row + 4 * page.width,
                        frame.bytes.begin() + 4 * ((y + kFrame) * frame.width + kFrame)))
            return false;
    }
    return true;
}

class Caller {
  public:
    Caller(const uint8_t* data, size_t size) : mIn(data, size) {
        for (vorel_look*& look : mLooks)
            require(vorel_look_new(&look) == VOREL_OK);
    }
    Caller(const Caller&) = delete;
    Caller& operator=(const Caller&) = delete;
    ~Caller() {
        for (vorel_look* look : mLooks)
            vorel_look_free(look);
        vorel_painter_free(mPainter);
        vorel_picture_free(mPicture);
    }

    void run() {
        for (int calls = 0; calls < kMostCalls && !mIn.atEnd(); ++calls)
            call();
    }

  private:
    // --- Arguments ------------------------------------------------------------------------------

    /// Null now and then.
    vorel_look* look() {
        const auto index = static_cast<size_t>(mIn.between(0, static_cast<int>(kLooks) - 1));
        return mIn.oneIn(32) ? nullptr : mLooks[index];
    }
    float angle() { return mIn.wildFloat(-720.0F, 720.0F); }
    float size() { return mIn.wildFloat(-2.0F, mIn.oneIn(8) ? 110.0F : 9.0F); }
    float opacity() { return mIn.wildFloat(-0.25F, 1.25F); }
    float scale() { return mIn.wildFloat(-0.5F, 3.0F); }

    std::vector<vorel_stop> stops() {
        const int count = mIn.oneIn(16) ? mIn.oneOf({255, 256, 257, 300}) : mIn.between(0, 5);
        std::vector<vorel_stop> all;
        for (int i = 0; i < count; ++i)
            all.push_back(vorel_stop{mIn.word(), opacity(), mIn.wildFloat(-0.2F, 1.2F)});
        return all;
    }

    /// A side that has pixels, or one that no buffer can stand for. A view may be as large as an int
    /// tells, and is taken at its word.
    int32_t side(int longest) {
        if (!mIn.oneIn(16)) return mIn.between(1, longest);
        const int32_t odd = mIn.oneOf({-1, 0, INT_MIN, INT_MAX});
        return odd == INT_MAX && longest == kLongestView ? 0 : odd;
    }

    /// Sides that are large or negative have no bytes: they must be refused before any is read.
    Rows decodeRows(int longest, int bytesPerPixel) {
        Rows rows;
        rows.width = side(longest);
        rows.height = side(longest);
        const bool isReal =
            std::min(rows.width, rows.height) >= 0 && std::max(rows.width, rows.height) <= longest;
        const ptrdiff_t packed = isReal ? ptrdiff_t{rows.width} * bytesPerPixel : 0;
        const uint8_t kind = mIn.byte();
        if (kind >= 0xC0) rows.stride = packed + mIn.between(0, 9);
        if (kind >= 0xF0) rows.stride = mIn.oneOf({-1, 1, INT_MIN, static_cast<int>(packed) - 1});
        rows.isReadable = isReal && std::min(rows.width, rows.height) > 0 &&
                          (rows.stride == 0 || rows.stride >= packed);
        const ptrdiff_t step = rows.stride == 0 ? packed : rows.stride;
        rows.bytes.resize(rows.isReadable ? static_cast<size_t>(step * (rows.height - 1) + packed) : 1);
        vorel_fuzz::fillCoverage(mIn, rows.bytes.data(), rows.bytes.size());
        rows.isNull = mIn.oneIn(32);
        return rows;
    }

    /// Near each other, anywhere that an int can tell; or so far apart that no layer holds them.
    Line decodeLine() {
        Line line;
        const int x = mIn.oneIn(8) ? mIn.oneOf({INT_MIN, INT_MAX - 128, 65536, -65536}) : 0;
        const int y = mIn.oneIn(8) ? mIn.oneOf({INT_MIN, INT_MAX - 128, 65536, -65536}) : 0;
        const int count = mIn.between(0, 3);
        for (int i = 0; i < count; ++i) {
            line.rows.push_back(decodeRows(kLongestGlyph, 1));
            const Rows& rows = line.rows.back();
            vorel_glyph glyph = {};
            glyph.x = x + mIn.between(0, 60);
            glyph.y = y + mIn.between(0, 40);
            glyph.width = rows.width;
            glyph.height = rows.height;
            glyph.stride = rows.stride;
            line.glyphs.push_back(glyph);
        }
        for (size_t i = 0; i < line.rows.size(); ++i)
            line.glyphs[i].coverage = line.rows[i].data();
        if (count > 1 && x == 0 && mIn.oneIn(16)) line.glyphs.back().x = INT_MAX;
        line.isNull = mIn.oneIn(32);
        return line;
    }

    static vorel_view viewOf(Rows& rows, int32_t order) {
        return vorel_view{rows.data(), rows.width, rows.height, rows.stride, order};
    }
    int32_t order() { return mIn.oneIn(16) ? mIn.wildInt(2, 9) : mIn.between(VOREL_RGBA, VOREL_BGRA); }
    int32_t place() {
        return mIn.oneIn(8) ? mIn.oneOf({INT_MIN, INT_MAX, 65536, -65536}) : mIn.between(-60, 60);
    }

    std::vector<vorel_look*> stack() {
        std::vector<vorel_look*> looks;
        const int count = mIn.between(0, 3);
        for (int i = 0; i < count; ++i)
            looks.push_back(look());
        return looks;
    }

    // --- Calls ----------------------------------------------------------------------------------

    void call();
    void changeLook();
    void addShadow();
    void addGlow();
    void addGradient();
    void addPattern();
    void copyLook();
    void askLook();
    void makePainter();
    void paintView();
    void paintPicture();
    void layPicture();

    /// A page is whole where a call failed, and outside of what it says it touched.
    static void requireTouched(const Rows& before, const Rows& after, vorel_status status,
                               const vorel_box& touched) {
        if (status != VOREL_OK || touched.right == 0) {
            require(before.bytes == after.bytes && Reach{}.isThat(touched));
            return;
        }
        require(0 <= touched.left && touched.left < touched.right && touched.right <= after.width);
        require(0 <= touched.top && touched.top < touched.bottom && touched.bottom <= after.height);
        const ptrdiff_t step = after.stride == 0 ? ptrdiff_t{4} * after.width : after.stride;
        for (size_t i = 0; i < after.bytes.size(); ++i) {
            const auto row = static_cast<ptrdiff_t>(i) / step;
            const auto column = static_cast<ptrdiff_t>(i) % step;
            const bool isInside = row >= touched.top && row < touched.bottom &&
                                  column >= ptrdiff_t{4} * touched.left &&
                                  column < ptrdiff_t{4} * touched.right;
            require(isInside || before.bytes[i] == after.bytes[i]);
        }
    }

    /// Where the picture lies, from the origin of its text.
    Reach pictureReach() const {
        const int64_t left = vorel_picture_left(mPicture);
        const int64_t top = vorel_picture_top(mPicture);
        return {left, top, left + vorel_picture_width(mPicture), top + vorel_picture_height(mPicture)};
    }

    Decoder mIn;
    int mPaints = 0;
    std::array<vorel_look*, kLooks> mLooks{};
    vorel_painter* mPainter = nullptr;
    vorel_picture* mPicture = nullptr;
};

void Caller::call() {
    constexpr void (Caller::*kCalls[])() = {
        &Caller::changeLook, &Caller::addShadow,    &Caller::addGlow,   &Caller::addGradient,
        &Caller::addPattern, &Caller::copyLook,     &Caller::askLook,   &Caller::makePainter,
        &Caller::paintView,  &Caller::paintPicture, &Caller::layPicture};
    (this->*kCalls[mIn.between(0, static_cast<int>(std::size(kCalls)) - 1)])();
}

void Caller::changeLook() {
    vorel_look* const it = look();
    vorel_status status = VOREL_OK;
    const int kind = mIn.between(0, 3);
    const uint32_t color = mIn.word();
    const float number = size();
    if (kind == 0) status = vorel_look_fill(it, color, number);
    if (kind == 1) status = vorel_look_no_fill(it);
    if (kind == 2) status = vorel_look_text_opacity(it, number);
    if (kind == 3) {
        const int32_t position = mIn.wildInt(VOREL_CENTRE, VOREL_INSIDE + 1);
        status = vorel_look_stroke(it, number, color, opacity(), position);
        const bool isPosition = position >= VOREL_CENTRE && position <= VOREL_INSIDE;
        require((status == VOREL_OK) == (isPosition && it != nullptr));
    }
    require(status == VOREL_OK || status == VOREL_BAD_ARGUMENT);
    require(it != nullptr || status == VOREL_BAD_ARGUMENT);
}

void Caller::addShadow() {
    vorel_look* const it = look();
    const auto add = mIn.flag() ? vorel_look_outer_shadow : vorel_look_inner_shadow;
    const float degrees = angle();
    const float distance = size();
    const float blur = size();
    const uint32_t color = mIn.word();
    const vorel_status status = add(it, degrees, distance, blur, color, opacity());
    require(status == (it == nullptr ? VOREL_BAD_ARGUMENT : VOREL_OK));
}

void Caller::addGlow() {
    vorel_look* const it = look();
    const auto add = mIn.flag() ? vorel_look_outer_glow : vorel_look_inner_glow;
    const float reach = size();
    const uint32_t color = mIn.word();
    const float alpha = opacity();
    const std::vector<vorel_stop> list = stops();
    const bool hasList = !mIn.oneIn(16);
    const vorel_status status =
        add(it, reach, color, alpha, hasList ? list.data() : nullptr, list.size());
    const bool isRefused = it == nullptr || (!hasList && !list.empty());
    require(status == (isRefused ? VOREL_BAD_ARGUMENT : VOREL_OK));
}

void Caller::addGradient() {
    vorel_look* const it = look();
    const bool isLinear = mIn.flag();
    const float degrees = angle();
    const float length = scale();
    const float alpha = opacity();
    const std::vector<vorel_stop> list = stops();
    const vorel_stop* const data = mIn.oneIn(16) ? nullptr : list.data();
    const vorel_status status =
        isLinear ? vorel_look_linear_gradient(it, degrees, length, alpha, data, list.size())
                 : vorel_look_radial_gradient(it, length, alpha, data, list.size());
    const bool isRefused = it == nullptr || (data == nullptr && !list.empty());
    require(status == (isRefused ? VOREL_BAD_ARGUMENT : VOREL_OK));
}

void Caller::addPattern() {
    vorel_look* const it = look();
    Rows rows = decodeRows(9, 4);
    const vorel_pixels pixels = {rows.data(), rows.width, rows.height, rows.stride};
    const float factor = scale();
    const vorel_pixels* const handed = mIn.oneIn(32) ? nullptr : &pixels;
    const vorel_status status = vorel_look_pattern(it, handed, factor, opacity());
    const bool isReal = handed != nullptr && !rows.isNull && rows.isReadable;
    require((status == VOREL_OK) == (it != nullptr && isReal));
}

void Caller::copyLook() {
    const vorel_look* const it = look();
    const auto index = static_cast<size_t>(mIn.between(0, static_cast<int>(kLooks) - 1));
    vorel_look* copy = nullptr;
    if (vorel_look_copy(it, &copy) != VOREL_OK) {
        require(it == nullptr && copy == nullptr);
        return;
    }
    int32_t equal = 0;
    require(vorel_look_equal(it, copy, &equal) == VOREL_OK && equal == 1);
    vorel_look_free(mLooks[index]);
    mLooks[index] = copy;
}

void Caller::askLook() {
    const vorel_look* const it = look();
    vorel_margins margins = {};
    const vorel_status status = vorel_look_margins(it, &margins);
    require(status == (it == nullptr ? VOREL_BAD_ARGUMENT : VOREL_OK));
    require(std::min({margins.left, margins.top, margins.right, margins.bottom}) >= 0);
    size_t length = 0;
    if (vorel_look_key(it, nullptr, 0, &length) == VOREL_BAD_ARGUMENT) {
        require(it == nullptr);
        return;
    }
    const size_t room = mIn.flag() ? length : length / 2;
    std::vector<char> key(room, '\1');
    const bool fits = vorel_look_key(it, key.data(), room, &length) == VOREL_OK;
    require(fits == (room == length));
    require(std::find(key.begin(), key.end(), '\0') == key.end());
    require(fits || std::count(key.begin(), key.end(), '\1') == static_cast<ptrdiff_t>(room));
}

void Caller::makePainter() {
    const std::vector<vorel_look*> looks = stack();
    vorel_painter* painter = nullptr;
    const vorel_status status = vorel_painter_new(looks.data(), looks.size(), &painter);
    const bool hasNull = std::count(looks.begin(), looks.end(), nullptr) > 0;
    require(status == (hasNull ? VOREL_BAD_ARGUMENT : VOREL_OK));
    require((painter == nullptr) == hasNull);
    if (painter == nullptr) return;
    vorel_painter_free(mPainter);
    mPainter = painter;
}

/// Painted by a painter, and once: the same. So is what a larger page shows.
void Caller::paintView() {
    if (++mPaints > kMostPaints) return;
    const std::vector<vorel_look*> looks = stack();
    const Line line = decodeLine();
    const Rows before = decodeRows(kLongestView, 4);
    const int32_t bytes = order();
    const int32_t x = place();
    const int32_t y = place();
    Rows once = before;
    const vorel_view view = viewOf(once, bytes);
    vorel_box touched = {};
    const vorel_status status =
        vorel_paint(looks.data(), looks.size(), line.data(), line.glyphs.size(), &view, x, y, &touched);
    requireTouched(before, once, status, touched);
    require(status != VOREL_OK || touchedBy(looks, line, before, x, y).isThat(touched));

    vorel_painter* painter = nullptr;
    if (vorel_painter_new(looks.data(), looks.size(), &painter) != VOREL_OK) {
        require(status == VOREL_BAD_ARGUMENT);
        return;
    }
    Rows again = before;
    const vorel_view same = viewOf(again, bytes);
    require(vorel_painter_paint(painter, line.data(), line.glyphs.size(), &same, x, y, nullptr) ==
            status);
    require(again.bytes == once.bytes);
    if (status == VOREL_OK && before.isReadable && std::max(x, y) <= INT_MAX - kFrame) {
        Rows frame = framed(before);
        const vorel_view larger = viewOf(frame, bytes);
        require(vorel_painter_paint(painter, line.data(), line.glyphs.size(), &larger, x + kFrame,
                                    y + kFrame, nullptr) == VOREL_OK);
        require(standsIn(frame, once));
    }
    vorel_painter_free(painter);
}

void Caller::paintPicture() {
    if (++mPaints > kMostPaints) return;
    const Line line = decodeLine();
    vorel_picture* picture = nullptr;
    const vorel_status status =
        vorel_painter_picture(mPainter, line.data(), line.glyphs.size(), &picture);
    require((status == VOREL_OK) == (picture != nullptr));
    require(mPainter != nullptr || status == VOREL_BAD_ARGUMENT);
    if (picture == nullptr) return;
    vorel_picture_free(mPicture);
    mPicture = picture;
    const uint8_t* const pixels = vorel_picture_data(picture);
    const int32_t width = vorel_picture_width(picture);
    require(vorel_picture_stride(picture) == 4 * width);
    require((pixels == nullptr) == (width == 0));
    vorel_margins margins = {};
    require(vorel_painter_margins(mPainter, &margins) == VOREL_OK);
    require(width == 0 || pictureReach().isThat(reachOf(line).with(margins, 0, 0)));
}

void Caller::layPicture() {
    const Rows before = decodeRows(kLongestView, 4);
    Rows after = before;
    const vorel_view view = viewOf(after, order());
    const int32_t x = place();
    const int32_t y = place();
    vorel_box touched = {};
    const vorel_status status = vorel_picture_lay_over(mPicture, &view, x, y, &touched);
    requireTouched(before, after, status, touched);
    require(status != VOREL_OK || pictureReach().with({}, x, y).within(before).isThat(touched));
    vorel_view own = {};
    require((vorel_picture_view(mPicture, &own) == VOREL_OK) == (mPicture != nullptr));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    vorel_fuzz::useLevelOfInput(size);
    Caller(data, size).run();
    return 0;
}
