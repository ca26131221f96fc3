#include "sheet.h"

#include <algorithm>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "font_choice.h"
#include "layer_set.h"
#include "painting.h"
#include "progress.h"
#include "set_text.h"
#include "style_file.h"

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
    LayerSet looks;
    SetText label;
};

/// The cells of one size.
struct Column {
    SetText text;
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
SetText labelOf(const Options& options, const std::string& preset, int size) {
    Options plain;
    plain.fonts = options.fonts;
    const int labelSize = std::clamp(size / kLabelShare, kSmallestLabel, kLargestLabel);
    return {plain, voreltext::decodeUtf8(preset), labelSize};
}

Column columnOf(const Options& options, const SourceText& source, int size, const Note& note) {
    Options chosen = options;
    chosen.size = size;
    Column column{setToFit(chosen, source), {}};
    for (const std::string& preset : presetNames()) {
        chosen.preset = preset;
        const std::string prefix = preset + ": ";
        const Note noteOfPreset = [&](const std::string& line) { note(prefix + line); };
        column.cells.push_back(
            {LayerSet(chosen, chosenStyle(chosen), size, source.colours(), noteOfPreset),
             labelOf(chosen, preset, size)});
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
        size.label.grow(cell.label.layout().inkBox());
    }
    size.canvas = placedOn({{}, {}, {}, 0, padding}, column.text.box(), size.margins);
    size.width = std::max(size.canvas.width, size.label.width() + 2 * padding);
    size.height = size.canvas.height + size.label.height() + padding;
    return size;
}

/// Paints into the cell whose top left corner is at (left, top) of the sheet.
class CellPainter {
  public:
    CellPainter(Image& sheet, const Options& options) : mSheet(sheet), mOptions(options) {}

    void paint(const Column& column, const CellSize& size, const Cell& cell, int left, int top) {
        const int slack = size.width - size.canvas.width;
        layOver(mSheet, voreltext::paint(cell.looks.layers(), column.text.layout(), size.canvas),
                left + slack / 2, top);

        const Box& name = cell.label.box();
        const Look plain({}, labelColour(mOptions.background), 1);
        const std::vector<Layer> layers{{&plain.effects()}};
        const Canvas band{size.width, size.label.height(), (size.width - name.width()) / 2 - name.left,
                          -size.label.top};
        layOver(mSheet, voreltext::paint(layers, cell.label.layout(), band), left,
                top + size.canvas.height);
    }

  private:
    Image& mSheet;
    const Options& mOptions;
};

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
    noteMissing(columns.front().text.layout(), source, note);
    for (size_t i = 0; i < columns.size(); ++i) {
        const CellSize& size = grid.sizes[i];
        noteCut(size.canvas, columns[i].text.layout().inkBox(), size.margins, note);
    }
}

void paintCells(Image& sheet, const std::vector<Column>& columns, const Grid& grid,
                const Options& options) {
    CellPainter painter(sheet, options);
    const size_t count = columns.front().cells.size();
    Progress progress("pictures", count * columns.size());
    for (size_t i = 0; i < count * columns.size(); ++i) {
        const int column = static_cast<int>(i) % grid.columns;
        const int row = static_cast<int>(i) / grid.columns;
        const size_t of = columns.size() == 1 ? 0 : static_cast<size_t>(column);
        const Cell& cell = columns[of].cells[columns.size() == 1 ? i : static_cast<size_t>(row)];
        painter.paint(columns[of], grid.sizes[of], cell, grid.left(column), row * grid.height());
        progress.advance();
    }
}

}  // namespace

int sheetColumns(int count, int cellWidth, int cellHeight) {
    int columns = 1;
    while (columns < count && columns * cellWidth < (count + columns - 1) / columns * cellHeight) {
        ++columns;
    }
    return columns;
}

void paintSheet(const Options& options, const Note& note) {
    const SourceText source(options);
    const std::vector<int> sizes =
        options.sheetSizes.empty() ? std::vector<int>{options.size} : options.sheetSizes;
    HeldNotes notes;
    std::vector<Column> columns;
    columns.reserve(sizes.size());
    for (const int size : sizes)
        columns.push_back(columnOf(options, source, size, notes.taker()));
    const Grid grid = gridOf(columns, options.canvas.padding);
    noteText(columns, grid, source, notes.taker());
    Image sheet = voreltext::transparentImage(grid.left(grid.columns), grid.rows * grid.height());
    if (options.strict) notes.refuse();
    paintCells(sheet, columns, grid, options);
    writePicture(options, std::move(sheet));
    notes.giveTo(note);
}

}  // namespace vorelpaint
