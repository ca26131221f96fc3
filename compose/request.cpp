#include "compose/request.h"

#include "compose/error.h"

namespace vorelcompose {

void checkCanvas(const Request& request) {
    const voreltext::CanvasRequest& canvas = request.canvas;
    if (request.fit == Fit::wrap && !canvas.width) {
        throw ComposeError("fit: wrap breaks lines at a width; none is given");
    }
    if (request.fit == Fit::shrink && !canvas.width && !canvas.height) {
        throw ComposeError("fit: shrink makes a text fit a width or a height; neither is given");
    }
}

}  // namespace vorelcompose
