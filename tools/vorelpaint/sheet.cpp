#include "sheet.h"

#include <algorithm>
#include <cstring>
#include <string>
#include <utility>
#include <vector>

#include "font_choice.h"
#include "progress.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using vorelstyle::Look;
using voreltext::Box;
using voreltext::decodeUtf8;
using voreltext::Font;
using voreltext::FontFile;
using voreltext::Fonts;
using voreltext::Frame;
using voreltext::Image;
using voreltext::Margins;
using voreltext::marginsOf;
using voreltext::TextLayout;

constexpr int kSmallestLabel = 10;
constexpr int kLargestLabel = 40;
constexpr int kLabelShare = 6;  ///< the text's size in sizes of its label

/// The presets' text with its effects above, the preset's name below.
struct Cell {
    Look look;
    TextLayout label;
};

/// What every cell of the sheet measures: the room that the most reaching effects need on each side, and
/// a band for the name.
struct Grid {
    Margins margins{0, 0, 0, 0};
    Box label;  ///< around every name, from the start of its baseline
    int width = 0;
    int height = 0;
    int columns = 0;
    int rows = 0;
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

Cell makeCell(const Options& options, const std::string& preset, Fonts& labelFonts, const Warn& warn) {
    Options chosen = options;
    chosen.preset = preset;
    return {makeLook(chosen, chosenStyle(chosen), warn), TextLayout(labelFonts, decodeUtf8(preset))};
}

void grow(Margins& margins, const Margins& others) {
    margins = {std::max(margins.left, others.left), std::max(margins.top, others.top),
               std::max(margins.right, others.right), std::max(margins.bottom, others.bottom)};
}

void grow(Box& box, const Box& other) {
    box = {std::min(box.left, other.left), std::min(box.top, other.top),
           std::max(box.right, other.right), std::max(box.bottom, other.bottom)};
}

Grid gridOf(std::vector<Cell>& cells, const Box& ink, int padding) {
    Grid grid;
    for (Cell& cell : cells) {
        grow(grid.margins, marginsOf(cell.look.effects()));
        grow(grid.label, cell.label.inkBox());
    }
    const Frame frame{ink, grid.margins, padding};
    const int count = static_cast<int>(cells.size());
    grid.width = std::max(frame.width(), grid.label.width() + 2 * padding);
    grid.height = frame.height() + grid.label.height() + padding;
    grid.columns = sheetColumns(count, grid.width, grid.height);
    grid.rows = (count + grid.columns - 1) / grid.columns;
    voreltext::checkSize(grid.columns * grid.width, grid.rows * grid.height);
    return grid;
}

size_t offsetOf(const Image& image, int x, int y) {
    return (static_cast<size_t>(y) * static_cast<size_t>(image.width) + static_cast<size_t>(x)) * 4;
}

/// Lays a picture on an empty part of the sheet.
void lay(Image& sheet, const Image& picture, int x, int y) {
    const size_t bytes = static_cast<size_t>(picture.width) * 4;
    for (int row = 0; row < picture.height; ++row) {
        std::memcpy(&sheet.pixels[offsetOf(sheet, x, y + row)],
                    &picture.pixels[offsetOf(picture, 0, row)], bytes);
    }
}

/// Lays the picture of a cell and of its name into the cell at (left, top).
void layCell(Image& sheet, const Grid& grid, int left, int top, Cell& cell, const TextLayout& text,
             int padding, uint32_t colour) {
    const Margins margins = marginsOf(cell.look.effects());
    const Frame frame{text.inkBox(), grid.margins, padding};
    const int slack = grid.width - frame.width();
    lay(sheet, paint(cell.look.effects(), text, 0),
        left + slack / 2 + padding + grid.margins.left - margins.left,
        top + padding + grid.margins.top - margins.top);

    if (cell.label.glyphCount() == 0) return;  // the font has blanks for these letters
    const Box& name = cell.label.inkBox();
    const int baseline = top + frame.height() - grid.label.top;
    Look look({}, colour, 1);
    lay(sheet, paint(look.effects(), cell.label, 0), left + (grid.width - name.width()) / 2,
        baseline + name.top);
}

}  // namespace

int sheetColumns(int count, int cellWidth, int cellHeight) {
    int columns = 1;
    while (columns < count && columns * cellWidth < (count + columns - 1) / columns * cellHeight) {
        ++columns;
    }
    return columns;
}

void paintSheet(const Options& options, const Warn& warn) {
    const FontFile file = findFont(options.font);
    Fonts fonts{Font(file, options.size)};
    Fonts labelFonts{Font(file, std::clamp(options.size / kLabelShare, kSmallestLabel, kLargestLabel))};
    const TextLayout text = layOutText(options, fonts, warn);
    std::vector<Cell> cells;
    for (const std::string& preset : presetNames())
        cells.push_back(makeCell(options, preset, labelFonts, warn));
    const Grid grid = gridOf(cells, text.inkBox(), options.padding);

    Image sheet{grid.columns * grid.width, grid.rows * grid.height, {}};
    sheet.pixels.resize(static_cast<size_t>(sheet.width) * static_cast<size_t>(sheet.height) * 4);
    Progress progress("presets", cells.size());
    for (size_t i = 0; i < cells.size(); ++i) {
        const int column = static_cast<int>(i) % grid.columns;
        const int row = static_cast<int>(i) / grid.columns;
        layCell(sheet, grid, column * grid.width, row * grid.height, cells[i], text, options.padding,
                labelColour(options.background));
        progress.advance();
    }
    writePicture(options, std::move(sheet));
}

}  // namespace vorelpaint
