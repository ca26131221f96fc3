#include "sheet.h"

#include <algorithm>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "crew.h"
#include "painting.h"
#include "progress.h"
#include "style_file.h"
#include "workbench.h"

namespace vorelpaint {
namespace {

using vorelstyle::Look;
using voreltext::Box;
using voreltext::Canvas;
using voreltext::Image;
using voreltext::Layer;
using voreltext::Margins;

constexpr int kSmallestLabel = 10;
constexpr int kLargestLabel = 40;
constexpr int kLabelShare = 6;  ///< the text's size in sizes of its label

/// The presets' text in one size with its effects above, the preset's name below.
struct Cell {
    std::string preset;
    LayerSet looks;
    Box label;  ///< the ink of the name, from the start of its baseline
};

/// A cell that is painted.
struct CellPicture {
    Image text;
    Image label;
};

/// The cells of one size.
struct Column {
    Options options;
    std::shared_ptr<const SetText> text;
    std::vector<Cell> cells;
};

/// What every cell of a column measures: the room that the most reaching effects need on each side, and
/// a band for the name.
struct CellSize {
    Margins margins{0, 0, 0, 0};
    Canvas canvas{};  ///< of the text and its effects
    Box label;        ///< around every name, from the start of its baseline
    int width = 0;
    int height = 0;
};

/// Reads on a dark and on a light ground alike, unless the ground is known.
uint32_t labelColour(const Background& background) {
    constexpr uint32_t kGrey = 0x808080;
    if (background.kind == Background::Kind::transparent) return kGrey;
    if (background.kind == Background::Kind::checkerboard) return 0;
    const uint32_t colour = background.colour;
    const uint32_t brightness =
        (299 * (colour >> 16) + 587 * ((colour >> 8) & 0xFF) + 114 * (colour & 0xFF)) / 1000;
    return brightness < 128 ? 0xFFFFFF : 0;
}

/// A preset's name, set plainly in the first font.
SetText labelOf(const Options& options, Workbench& bench, const std::string& preset) {
    Options plain;
    plain.fonts = options.fonts;
    const int size = std::clamp(options.size / kLabelShare, kSmallestLabel, kLargestLabel);
    return {plain, bench.fonts, voreltext::decodeUtf8(preset), size};
}

Column columnOf(const Options& options, Workbench& bench, const SourceText& source, int size,
                const Note& note) {
    Options chosen = options;
    chosen.size = size;
    Column column{chosen, bench.texts.text(chosen, bench.fonts, source), {}};
    for (const std::string& preset : presetNames()) {
        chosen.preset = preset;
        const std::string prefix = preset + ": ";
        const Note noteOfPreset = [&](const std::string& line) { note(prefix + line); };
        column.cells.push_back({preset, looksOf(chosen, source.colours(), noteOfPreset),
                                labelOf(chosen, bench, preset).layout().inkBox()});
    }
    return column;
}

void grow(Margins& margins, const Margins& others) {
    margins = {std::max(margins.left, others.left), std::max(margins.top, others.top),
               std::max(margins.right, others.right), std::max(margins.bottom, others.bottom)};
}

CellSize sizeOf(const Column& column, int padding) {
    CellSize size;
    for (const Cell& cell : column.cells) {
        grow(size.margins, marginsOf(cell.looks.layers()));
        size.label.grow(cell.label);
    }
    size.canvas = placedOn({{}, {}, {}, 0, padding}, column.text->box(), size.margins);
    size.width = std::max(size.canvas.width, size.label.width() + 2 * padding);
    size.height = size.canvas.height + size.label.height() + padding;
    return size;
}

/// Fonts are for one thread: the text and the name are set in those of the workbench.
CellPicture paintedCell(const Column& column, const SourceText& source, const CellSize& size,
                        const Cell& cell, Workbench& bench) {
    const auto text = bench.texts.text(column.options, bench.fonts, source);
    const SetText name = labelOf(column.options, bench, cell.preset);
    const Look plain({}, labelColour(column.options.background), 1);
    const std::vector<Layer> layers{{&plain.effects()}};
    const Canvas band{size.width, size.label.height(),
                      (size.width - name.box().width()) / 2 - name.box().left, -size.label.top};
    return {voreltext::paint(cell.looks.layers(), text->layout(), size.canvas),
            voreltext::paint(layers, name.layout(), band)};
}

/// Where the cells of a sheet stand: those of one size beside and below each other, those of several
/// sizes in a column for each.
struct Grid {
    int columns;
    int rows;
    std::vector<CellSize> sizes;

    int width(size_t column) const { return sizes[sizes.size() == 1 ? 0 : column].width; }
    int height() const {
        int most = 0;
        for (const CellSize& size : sizes)
            most = std::max(most, size.height);
        return most;
    }
    int left(int column) const {
        int left = 0;
        for (int i = 0; i < column; ++i)
            left += width(static_cast<size_t>(i));
        return left;
    }
};

Grid gridOf(const std::vector<Column>& columns, int padding) {
    Grid grid{static_cast<int>(columns.size()), static_cast<int>(columns.front().cells.size()), {}};
    for (const Column& column : columns)
        grid.sizes.push_back(sizeOf(column, padding));
    if (columns.size() > 1) return grid;
    const int count = grid.rows;
    grid.columns = sheetColumns(count, grid.width(0), grid.height());
    grid.rows = (count + grid.columns - 1) / grid.columns;
    return grid;
}

/// Notes what is told of the text itself, whatever its look. What the fonts lack they lack in any size.
void noteText(const std::vector<Column>& columns, const Grid& grid, const SourceText& source,
              const Note& note) {
    noteMissing(columns.front().text->layout(), source, note);
    for (size_t i = 0; i < columns.size(); ++i) {
        const CellSize& size = grid.sizes[i];
        noteCut(size.canvas, columns[i].text->layout().inkBox(), size.margins, note);
    }
}

/// Paints the cells on threads, and lays them on the sheet in their order.
class SheetPainter {
  public:
    SheetPainter(const std::vector<Column>& columns, const SourceText& source, const Grid& grid)
        : mColumns(columns),
          mSource(source),
          mGrid(grid),
          mCount(columns.front().cells.size() * columns.size()),
          mPictures(mCount),
          mCrew(threadsFor(columns.front().options)) {}

    void paintOn(Image& sheet) {
        Progress progress("pictures", mCount);
        size_t begun = 0;
        for (size_t i = 0; i < mCount; ++i) {
            for (; begun < mCount && !mCrew.isFull(); ++begun)
                begin(begun);
            mCrew.take();
            lay(sheet, i);
            progress.advance();
        }
    }

  private:
    /// The column and the row of a cell in the grid.
    int columnOf(size_t i) const { return static_cast<int>(i) % mGrid.columns; }
    int rowOf(size_t i) const { return static_cast<int>(i) / mGrid.columns; }

    /// Its size among the columns, which are one or as many as those of the grid.
    size_t sizeOf(size_t i) const { return mColumns.size() == 1 ? 0 : static_cast<size_t>(columnOf(i)); }

    const Cell& cell(size_t i) const {
        return mColumns[sizeOf(i)].cells[mColumns.size() == 1 ? i : static_cast<size_t>(rowOf(i))];
    }

    void begin(size_t i) {
        mCrew.give([this, i](Workbench& bench) {
            const size_t size = sizeOf(i);
            mPictures[i] = paintedCell(mColumns[size], mSource, mGrid.sizes[size], cell(i), bench);
        });
    }

    /// And frees its picture.
    void lay(Image& sheet, size_t i) {
        const CellPicture picture = std::move(mPictures[i]);
        const CellSize& size = mGrid.sizes[sizeOf(i)];
        const int left = mGrid.left(columnOf(i));
        const int top = rowOf(i) * mGrid.height();
        layOver(sheet, picture.text, left + (size.width - size.canvas.width) / 2, top);
        layOver(sheet, picture.label, left, top + size.canvas.height);
    }

    const std::vector<Column>& mColumns;
    const SourceText& mSource;
    const Grid& mGrid;
    size_t mCount;
    std::vector<CellPicture> mPictures;
    Crew mCrew;  ///< ends before what it works at
};

}  // namespace

int sheetColumns(int count, int cellWidth, int cellHeight) {
    int columns = 1;
    while (columns < count && columns * cellWidth < (count + columns - 1) / columns * cellHeight) {
        ++columns;
    }
    return columns;
}

void paintSheet(const Options& options, const Note& note) {
    const SourceText source = sourceOf(options);
    const std::vector<int> sizes =
        options.sheetSizes.empty() ? std::vector<int>{options.size} : options.sheetSizes;
    HeldNotes notes;
    Workbench bench;
    std::vector<Column> columns;
    columns.reserve(sizes.size());
    for (const int size : sizes)
        columns.push_back(columnOf(options, bench, source, size, notes.taker()));
    const Grid grid = gridOf(columns, options.canvas.padding);
    noteText(columns, grid, source, notes.taker());
    Image sheet = voreltext::transparentImage(grid.left(grid.columns), grid.rows * grid.height());
    if (options.strict) notes.refuse();
    SheetPainter(columns, source, grid).paintOn(sheet);
    writePicture(options, std::move(sheet));
    notes.giveTo(note);
}

}  // namespace vorelpaint
