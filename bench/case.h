#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

/// What is measured: a case is one row of the tables done by one maker.
namespace vorel_bench {

/// Bytes that somebody else owns.
struct Bytes {
    const uint8_t* data = nullptr;
    size_t size = 0;
};

/// A piece of work that can be done again and again on the same buffers.
class Job {
  public:
    Job() = default;
    Job(const Job&) = delete;
    Job& operator=(const Job&) = delete;
    virtual ~Job() = default;

    virtual void reset() {}    ///< brings the pixels back to what they were before; never timed
    virtual void paint() = 0;  ///< the work itself

    /// The pixels after paint(); empty where they cannot be compared with another maker's.
    virtual Bytes painted() const { return {}; }
    /// Bytes of the layers that paint() makes for itself, which do not count as working memory.
    virtual size_t layerBytes() const { return 0; }
};

/// The library itself: its cases run once per level. Any other maker runs once.
constexpr char kOurs[] = "voreleffect";
constexpr char kLiteral[] = "literal";

struct Case {
    std::string row;    ///< subject/variant/workload/parameter
    std::string maker;  ///< kOurs, kLiteral, "memcpy" or a peer
    int64_t pixels;     ///< what a figure per pixel is divided by
    std::function<std::unique_ptr<Job>()> make;
};
using Cases = std::vector<Case>;

/// A case whose jobs are made of `arguments`, which are kept by value.
template <class JobType, class... Arguments>
Case caseOf(const std::string& row, const std::string& maker, int64_t pixels, Arguments... arguments) {
    return {row, maker, pixels, [=] { return std::make_unique<JobType>(arguments...); }};
}

/// Copies `bytes` bytes: what any change of as many bytes costs at least.
Case copyCase(const std::string& row, int64_t pixels, int64_t bytes);

struct Workload;

constexpr char kLooks[] = {'A', 'B', 'C', 'D'};
/// Clear pixels on each side of a workload that wears a look.
constexpr int kLookMargin = 40;

/// The library paints a look on a workload, which must outlive the case.
Case lookCase(char look, const Workload& workload);
/// The literal form does.
Case literalLookCase(char look, const Workload& workload);
/// Other programs do what the looks need at least; nothing in a build without peers.
void addLookPeers(Cases& cases, const Workload& workload);

/// The sizes that strokes, shadows and glows are measured at.
constexpr int kRadii[] = {1, 2, 4, 8, 16, 32, 64, 100};

void addStrokeCases(Cases& cases);
void addShadowCases(Cases& cases);
void addGlowCases(Cases& cases);
void addBlendCases(Cases& cases);
void addFillCases(Cases& cases);
void addLookCases(Cases& cases);
void addFaceCases(Cases& cases);
void addPeerCases(Cases& cases);  ///< none in a build without peers

/// All of them.
Cases allCases();

}  // namespace vorel_bench
