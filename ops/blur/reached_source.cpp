#include "ops/blur/reached_source.h"

namespace VFontEffect::internal {

ReachedSource ReachedSource::of(const CoverageRows& source, int64_t radius, const Box& window) {
    const Box reach = intersection(expanded(window, radius), {0, 0, source.width, source.height});
    ReachedSource reached = {source, 0, 0};
    if (reach.empty()) {
        reached.part.width = reached.part.height = 0;
        return reached;
    }
    reached.part.start += reach.top * source.stride + reach.left;
    reached.part.width = reach.width();
    reached.part.height = reach.height();
    reached.left = reach.left;
    reached.top = reach.top;
    return reached;
}

}  // namespace VFontEffect::internal
