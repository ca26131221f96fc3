#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "text/clusters.h"
#include "text/font.h"
#include "text/fontconfig.h"

namespace voreltext {

/// Which installed font has the characters of a cluster.
class FontCoverage {
  public:
    /// The configuration must outlive it; null, where there is none, has no fonts.
    explicit FontCoverage(FcConfig* config) : mConfig(config) {}

    /// The font most like the other one that has the cluster. What was found is kept, for a bounded
    /// number of clusters, and so is the order of the fonts.
    std::optional<FontFile> find(const Cluster& cluster, const FontFile& like);

  private:
    struct Candidate {
        FontFile file;
        const FcCharSet* characters;  ///< the list's
        bool isColour;
    };

    /// The installed fonts, those most like a given one first.
    struct Ranking {
        FontList fonts;
        std::vector<Candidate> candidates;
        std::map<Cluster, std::optional<FontFile>> found;
    };

    Ranking& rankingFor(const FontFile& like);
    FontPattern wantedLike(const FontFile& like) const;
    void rank(Ranking& ranking, const FontFile& like) const;

    FcConfig* mConfig;
    std::map<std::pair<std::string, long>, Ranking> mRankings;
};

}  // namespace voreltext
