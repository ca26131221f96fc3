#include "text/clusters.h"

#include <algorithm>

#include "unicode/characters.h"

namespace voreltext {
namespace {

using vorelunicode::isRegionalIndicator;
using vorelunicode::isSkinTone;

bool contains(const Cluster& cluster, uint32_t code) {
    return std::find(cluster.begin(), cluster.end(), code) != cluster.end();
}

bool isFlag(const Cluster& cluster) {
    return cluster.size() > 1 && isRegionalIndicator(cluster[0]) && isRegionalIndicator(cluster[1]);
}

bool isSequence(const Cluster& cluster) {
    return cluster.size() > 1 && vorelunicode::isSymbol(cluster[0]) &&
           (contains(cluster, vorelunicode::kZeroWidthJoiner) ||
            std::any_of(cluster.begin() + 1, cluster.end(), isSkinTone));
}

}  // namespace

Presentation presentationOf(const Cluster& cluster) {
    if (contains(cluster, vorelunicode::kPicturePresentation)) return Presentation::picture;
    if (contains(cluster, vorelunicode::kTextPresentation)) return Presentation::text;
    return isFlag(cluster) || isSequence(cluster) ? Presentation::picture : Presentation::any;
}

bool isPictureByDefault(const Cluster& cluster) {
    const Presentation presentation = presentationOf(cluster);
    return presentation == Presentation::picture ||
           (presentation == Presentation::any && !cluster.empty() &&
            vorelunicode::isPictureByDefault(cluster.front()));
}

}  // namespace voreltext
