#include "case.h"

#include <cstring>

namespace vorel_bench {
namespace {

class CopyJob : public Job {
  public:
    explicit CopyJob(int64_t bytes) : mFrom(static_cast<size_t>(bytes), 1), mTo(mFrom.size()) {}
    void paint() override { std::memcpy(mTo.data(), mFrom.data(), mTo.size()); }

  private:
    std::vector<uint8_t> mFrom;
    std::vector<uint8_t> mTo;
};

}  // namespace

Case copyCase(const std::string& row, int64_t pixels, int64_t bytes) {
    return caseOf<CopyJob>(row, "memcpy", pixels, bytes);
}

#ifndef VOREL_BENCH_PEERS
void addPeerCases(Cases&) {}
void addLookPeers(Cases&, const Workload&) {}
#endif

Cases allCases() {
    Cases cases;
    addStrokeCases(cases);
    addShadowCases(cases);
    addGlowCases(cases);
    addBlendCases(cases);
    addFillCases(cases);
    addLookCases(cases);
    addFaceCases(cases);
    addPeerCases(cases);
    return cases;
}

}  // namespace vorel_bench
