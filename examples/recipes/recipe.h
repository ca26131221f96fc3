// What the recipes share.
#pragma once

#include "../shared/page.h"

/// The font of the recipes that have none from a toolkit.
constexpr const char* kFont = "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";

/// Ends the program with the words where they are not true.
void check(bool isTrue, const char* words);
