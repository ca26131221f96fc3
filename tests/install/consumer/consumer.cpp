#include <cstdio>

#include "painted.h"

/// A program outside the project: prints the version of the headers when the library paints.
int main() {
    if (!paintsFillAndOutline()) return 1;
    // The log reaches into the C library, which a static library leaves to the program.
    VFontEffect::VFLog::setPrintLogLevel(0);
    VFontEffect::VFLog::printLog(VFontEffect::VFLogError, "consumer", "%s", "silenced");
    std::puts(VOREL_VERSION_STRING);
    return 0;
}
